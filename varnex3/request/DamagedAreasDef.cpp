#include "varnex3/request/DamagedAreasDef.h"

namespace varnex3 {

VARNEX_DEFINE(DamagedAreasDef);

void DamagedAreasDef::Add(const Text& sValue) { areas.Add(sValue); }

Text DamagedAreasDef::DamagedAreas(std::int32_t Index) { return areas.At(Index); }

void DamagedAreasDef::DamagedAreas(std::int32_t Index, const Text& value) { areas.Set(Index, value); }

Text DamagedAreasDef::DamagedAreasCSV(const Text& sDelimiter)
{
    if (Count() < 1)
        return {};
    Text joined;
    for (const Text& area : areas)
        joined += area + sDelimiter;
    if (joined.empty())
        Raise(ErrorNumber::InvalidArgument, "DamagedAreasDef.DamagedAreasCSV",
              u"sDelimiter: '' leaves no character to cut behind areas that are all empty");
    joined.pop_back(); // one character, however long the delimiter
    return joined;
}

std::int16_t DamagedAreasDef::Count() const { return areas.Count(); }

} // namespace varnex3
