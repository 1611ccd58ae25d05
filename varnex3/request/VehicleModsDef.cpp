#include "varnex3/request/VehicleModsDef.h"

namespace varnex3 {

VARNEX_DEFINE(VehicleModsDef);

void VehicleModsDef::Add(const Text& sValue) { mods.Add(sValue); }

Text VehicleModsDef::VehicleMods(std::int32_t Index) { return mods.At(Index); }

void VehicleModsDef::VehicleMods(std::int32_t Index, const Text& value) { mods.Set(Index, value); }

std::int16_t VehicleModsDef::Count() const { return mods.Count(); }

void VehicleModsDef::Write(XmlWriter& xml) const
{
    if (Count() < 1)
        return;

    xml.Open("VehicleMods");
    for (const Text& mod : mods)
        xml.Always("VehicleMod", mod);
    xml.Close("VehicleMods");
}

void VehicleModsDef::Read(const XmlSection& section)
{
    for (const xml::Node& mod : section.ElementsNamed("VehicleMods/VehicleMod"))
        Add(mod.Text());
}

} // namespace varnex3
