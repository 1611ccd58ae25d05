// The vehicle as the repairer sees it.
#pragma once

#include "varnex3/quote/VehicleDetailsDefOdometer.h"

namespace varnex3 {

class VehicleDetailsDef final : public Record
{
    VARNEX_RECORD(VehicleDetailsDef, "What the repairer knows of the vehicle beside its identification.");
    VARNEX_SERIALISE("The VehicleDetails group with the texts that are not empty; nothing when all are, whatever "
                     "odometer and engine size. What the odometer raises is raised here, too.");
    VARNEX_PARSEXML(Variant, "Reads every value; absent elements give 0 and the empty text. An engine size that is no "
                             "number raises TypeMismatch (13).");
    VARNEX_PROPERTY(Child<VehicleDetailsDefOdometer>, objOdometer, Odometer, "Odometer.");
    VARNEX_PROPERTY(double, dEngineSize, EngineSize, "Engine size; two decimals are written, when greater than 0.");
    VARNEX_PROPERTY(Text, sNoOfCylinders, NoOfCylinders, "Number of cylinders, a text.");
    VARNEX_PROPERTY(Text, sTransmission, Transmission, "Transmission.");
    VARNEX_PROPERTY(Text, sColour, Colour, "Colour; escaped when written.");
    VARNEX_PROPERTY(Text, sManufacturerPaintGroup, ManufacturerPaintGroup, "The manufacturer's paint group.");
    VARNEX_PROPERTY(Text, sManufacturerTrimCode, ManufacturerTrimCode, "The manufacturer's code of the trim.");
    VARNEX_PROPERTY(Text, sPaintCode, PaintCode, "Code of the paint.");
    VARNEX_PROPERTY(Text, sOptionCode, OptionCode, "Code of the options.");
    VARNEX_PROPERTY(Text, sVehicleLocation, VehicleLocation, "Where the vehicle is.");
    VARNEX_PROPERTY(Text, sVehicleSuburb, VehicleSuburb, "Suburb where the vehicle is.");

private:
    bool IsWritten() const;
    VARNEX_RECORD_END;
};

} // namespace varnex3
