#include "varnex3/quote/VehicleDetailsDef.h"

namespace varnex3 {

VARNEX_DEFINE(VehicleDetailsDef);

// Odometer and engine size do not cause the element.
bool VehicleDetailsDef::IsWritten() const
{
    return IsSet(sNoOfCylinders) || IsSet(sTransmission) || IsSet(sColour) || IsSet(sManufacturerPaintGroup)
           || IsSet(sManufacturerTrimCode) || IsSet(sPaintCode) || IsSet(sOptionCode) || IsSet(sVehicleLocation)
           || IsSet(sVehicleSuburb);
}

void VehicleDetailsDef::Write(XmlWriter& xml) const
{
    if (!IsWritten())
        return;

    xml.Open("VehicleDetails");
    xml.Append(objOdometer);
    xml.IfPositive("EngineSize", dEngineSize);
    xml.IfSet("NoOfCylinders", sNoOfCylinders);
    xml.IfSet("Transmission", sTransmission);
    xml.IfSet("Colour", Escaped(sColour)); // the only value here that is escaped
    xml.IfSet("ManufacturerPaintGroup", sManufacturerPaintGroup);
    xml.IfSet("ManufacturerTrimCode", sManufacturerTrimCode);
    xml.IfSet("PaintCode", sPaintCode);
    xml.IfSet("OptionCode", sOptionCode);
    xml.IfSet("VehicleLocation", sVehicleLocation);
    xml.IfSet("VehicleSuburb", sVehicleSuburb);
    xml.Close("VehicleDetails");
}

void VehicleDetailsDef::Read(const XmlSection& section)
{
    section.ReadInto(objOdometer, "VehicleDetails/Odometer");
    dEngineSize = section.NumberAt("VehicleDetails/EngineSize");
    sNoOfCylinders = section.TextAt("VehicleDetails/NoOfCylinders");
    sTransmission = section.TextAt("VehicleDetails/Transmission");
    sColour = section.TextAt("VehicleDetails/Colour");
    sManufacturerPaintGroup = section.TextAt("VehicleDetails/ManufacturerPaintGroup "); // the blank does not matter
    sManufacturerTrimCode = section.TextAt("VehicleDetails/ManufacturerTrimCode");
    sPaintCode = section.TextAt("VehicleDetails/PaintCode");
    sOptionCode = section.TextAt("VehicleDetails/OptionCode");
    sVehicleLocation = section.TextAt("VehicleDetails/VehicleLocation");
    sVehicleSuburb = section.TextAt("VehicleDetails/VehicleSuburb");
}

} // namespace varnex3
