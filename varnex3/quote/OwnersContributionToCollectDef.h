// What the owner of the vehicle is to pay.
#pragma once

#include "varnex3/core/Rows.h"

namespace varnex3 {

class OwnersContributionToCollectDef final : public Record
{
    VARNEX_RECORD(OwnersContributionToCollectDef, "The owner's contribution to the cost of the repair.");
    VARNEX_SERIALISE("The OwnersContributionToCollect group, at level 2; nothing unless there are both a reason and a "
                     "value greater than 0.");
    VARNEX_PARSEXML(Variant, "Reads both values; absent elements give 0 and the empty text. A value that is no number "
                             "raises TypeMismatch (13).");
    VARNEX_PROPERTY(double, dValue, Value, "The contribution, in dollars.");
    VARNEX_PROPERTY(Text, sReason, Reason, "What it is for; written as it is.");
    static constexpr int kLevel = 2; // inside the quote's details
    VARNEX_RECORD_END;
};

} // namespace varnex3
