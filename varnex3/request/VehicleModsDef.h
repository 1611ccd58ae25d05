// What was modified on a vehicle.
#pragma once

#include "varnex3/core/Rows.h"
#include "varnex3/request/TextList.h"

namespace varnex3 {

// More than 32,767 modifications are kept, but Count and what depends on it, everything here except Add and ParseXML,
// then raises Overflow (6).
class VehicleModsDef final : public Record
{
    VARNEX_RECORD(VehicleModsDef, "An ordered list of the modifications of a vehicle, each a text.");
    VARNEX_SERIALISE("The VehicleMods group, a line for each modification; nothing when there is none.");
    VARNEX_PARSEXML(Variant, "Appends every VehicleMod that stands in a VehicleMods, at any depth; the list is not "
                             "cleared.");
    VARNEX_METHOD(void, Add, (const Text& sValue), "Appends a modification.");
    VARNEX_INDEXED(Text, VehicleMods, (std::int32_t Index),
                   "The modification at a position, from 0; written as it is. Out of range, reading gives the empty "
                   "text and setting does nothing.");
    VARNEX_READONLY(std::int16_t, Count, "Number of modifications.");

private:
    TextList mods{"VehicleModsDef.Count"};
    VARNEX_RECORD_END;
};

} // namespace varnex3
