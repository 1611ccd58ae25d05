// Who makes a claim.
#pragma once

#include "varnex3/core/Rows.h"

namespace varnex3 {

VARNEX_ENUM(ClaimantTypeEnum, "Who makes a claim.", (OtherParty, 0, "The other party of the incident."),
            (Insured, 1, "The insured person or company."));

// Has no Serialise: the request details write it.
class ClaimantTypeDef final : public Record
{
    VARNEX_RECORD(ClaimantTypeDef, "Who makes a claim.");
    VARNEX_PARSEXML(Text, "Reads OtherParty, or else Insured, whichever element is there; without either the type "
                          "stays as it was.");
    VARNEX_PROPERTY(ClaimantTypeEnum, eClaimantType, ClaimantType, "The claimant; any number is taken.");
    VARNEX_READONLY(Text, ClaimantTypeValue,
                    "Name of the element that stands for the claimant; empty for a number that is none of the "
                    "enumeration's.");
    VARNEX_RECORD_END;
};

} // namespace varnex3
