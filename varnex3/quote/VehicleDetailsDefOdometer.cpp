#include "varnex3/quote/VehicleDetailsDefOdometer.h"

namespace varnex3 {

VARNEX_DEFINE(VehicleDetailsDefOdometer);

bool VehicleDetailsDefOdometer::IsWritten() const
{
    if (!IsSet(sOdometerReading))
        return false;
    try {
        return Int32From(sOdometerReading) > 0;
    } catch (const Error& error) { // a reading that is no number is not passed over
        throw error.About("VehicleDetailsDefOdometer.Serialise", u"OdometerReading");
    }
}

void VehicleDetailsDefOdometer::Write(XmlWriter& xml) const
{
    if (!IsWritten())
        return;

    xml.Open("Odometer");
    xml.Always("OdometerReading", sOdometerReading);
    xml.Flag("OdometerUnitKm", eOdometerUnit == OdometerUnitEnum::OdometerUnitKm);
    xml.Flag("OdometerUnitMiles", eOdometerUnit == OdometerUnitEnum::OdometerUnitMiles);
    xml.Close("Odometer");
}

void VehicleDetailsDefOdometer::Read(const XmlSection& section)
{
    sOdometerReading = section.TextAt("Odometer/OdometerReading");
    if (section.Has("Odometer/OdometerUnitKm")) // wins when both are there
        eOdometerUnit = OdometerUnitEnum::OdometerUnitKm;
    else if (section.Has("Odometer/OdometerUnitMiles"))
        eOdometerUnit = OdometerUnitEnum::OdometerUnitMiles;
}

} // namespace varnex3
