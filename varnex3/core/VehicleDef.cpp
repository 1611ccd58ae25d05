#include "varnex3/core/VehicleDef.h"

namespace varnex3 {

VARNEX_DEFINE(VehicleDef);

void VehicleDef::Write(XmlWriter& xml) const
{
    const XmlWriter::Mark vehicle = xml.OpenUnlessEmpty("Vehicle");
    xml.IfSet("RegistrationNo", sRegistrationNo);
    xml.IfSet("EngineNo", sEngineNo);
    xml.IfSet("VIN", sVIN);
    xml.IfSet("BuildDate", sBuildDate);
    xml.IfSet("Make", sMake);
    xml.IfSet("ModelID", sModelID);
    xml.IfSet("Series", sSeries);
    xml.IfSet("EquipmentLevel", sEquipmentLevel);
    xml.IfSet("BodyStyle", sBodyStyle);
    xml.IfSet("Description", sDescription);
    xml.CloseUnlessEmpty(vehicle);
}

void VehicleDef::Read(const XmlSection& section)
{
    sRegistrationNo = section.TextAt("Vehicle/RegistrationNo");
    sEngineNo = section.TextAt("Vehicle/EngineNo");
    sVIN = section.TextAt("Vehicle/VIN");
    sBuildDate = section.TextAt("Vehicle/BuildDate");
    sMake = section.TextAt("Vehicle/Make");
    sModelID = section.TextAt("Vehicle/ModelID");
    sSeries = section.TextAt("Vehicle/Series");
    sEquipmentLevel = section.TextAt("Vehicle/EquipmentLevel");
    sBodyStyle = section.TextAt("Vehicle/BodyStyle");
    sDescription = section.TextAt("Vehicle/Description");
}

} // namespace varnex3
