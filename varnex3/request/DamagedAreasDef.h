// The damaged areas of a vehicle.
#pragma once

#include "varnex3/core/Rows.h"
#include "varnex3/request/TextList.h"

namespace varnex3 {

// Has no XML form of its own: the request details write and read the areas. More than 32,767 areas are kept, but Count
// and what depends on it, everything here except Add, then raises Overflow (6).
class DamagedAreasDef final : public Record
{
    VARNEX_RECORD(DamagedAreasDef, "An ordered list of the damaged areas of a vehicle, each a text.");
    VARNEX_METHOD(void, Add, (const Text& sValue), "Appends an area.");
    VARNEX_INDEXED(Text, DamagedAreas, (std::int32_t Index),
                   "The area at a position, from 0. Out of range, reading gives the empty text and setting does "
                   "nothing.");
    VARNEX_METHOD(Text, DamagedAreasCSV, (const Text& sDelimiter = u","),
                  "The areas, each followed by the delimiter, without the last character: of a longer delimiter the "
                  "rest stays at the end, with an empty one the last area loses a character. No areas give the empty "
                  "text; where there is no character to cut, InvalidArgument (5) is raised.");
    VARNEX_READONLY(std::int16_t, Count, "Number of areas.");

public:
    // The areas in order, for the record that writes them.
    const TextList& All() const { return areas; }

private:
    TextList areas{"DamagedAreasDef.Count"};
    VARNEX_RECORD_END;
};

} // namespace varnex3
