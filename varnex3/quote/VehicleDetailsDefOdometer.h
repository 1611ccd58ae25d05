// How far a vehicle has been driven.
#pragma once

#include "varnex3/core/Rows.h"

namespace varnex3 {

VARNEX_ENUM(OdometerUnitEnum, "What an odometer counts.", (OdometerUnitKm, 0, "Kilometres."),
            (OdometerUnitMiles, 1, "Miles."));

class VehicleDetailsDefOdometer final : public Record
{
    VARNEX_RECORD(VehicleDetailsDefOdometer, "The odometer of a vehicle.");
    VARNEX_SERIALISE("The Odometer group, at level 2; nothing when the reading is empty or, rounded, not greater than "
                     "0. A reading that is no number raises TypeMismatch (13), one beyond 32 bits Overflow (6).");
    VARNEX_PARSEXML(Variant, "Reads both values: an absent reading gives the empty text, without an element for either "
                             "unit the unit stays as it was.");
    VARNEX_PROPERTY(Text, sOdometerReading, OdometerReading, "The reading, a text; written as it is.");
    VARNEX_PROPERTY(OdometerUnitEnum, eOdometerUnit, OdometerUnit,
                    "Unit of the reading; a number that is none of the enumeration's is not written.");
    static constexpr int kLevel = 2; // inside the vehicle's details

private:
    bool IsWritten() const;
    VARNEX_RECORD_END;
};

} // namespace varnex3
