// Which claim, and which vehicle, a message is about.
#pragma once

#include "varnex3/core/Rows.h"

namespace varnex3 {

class ClaimHeaderDef final : public Record
{
    VARNEX_RECORD(ClaimHeaderDef, "The claim that a message is about.");
    VARNEX_SERIALISE("The ClaimHeader group; nothing when vehicle and claim number are both empty, whatever the "
                     "reinstatement number.");
    VARNEX_PARSEXML(Variant,
                    "Reads every value; an absent element gives its default, a reinstatement number that is no "
                    "number raises TypeMismatch (13), one outside 32 bits Overflow (6).");
    VARNEX_PROPERTY(Text, sVehicleID, VehicleID, "The insurer's identifier of the vehicle.");
    VARNEX_PROPERTY(Text, sInsuranceClaimNo, InsuranceClaimNo, "Claim number.");
    VARNEX_PROPERTY(std::int32_t, lReinstatementNo, ReinstatementNo, "Number of the reinstatement; 0 is written too.");
    VARNEX_RECORD_END;
};

} // namespace varnex3
