// The figures that the insurer expected on an invoice.
#pragma once

#include "varnex3/core/Rows.h"
#include "varnex3/quote/OwnersContributionToCollectDef.h"

namespace varnex3 {

class ExpectedPaymentDetailsDef final : public Record
{
    VARNEX_RECORD(ExpectedPaymentDetailsDef, "The figures that the insurer expected on an invoice.");
    VARNEX_SERIALISE("The ExpectedPaymentDetails group with the amounts that are greater than 0; nothing when none is. "
                     "The owner's contribution does not cause it.");
    VARNEX_PARSEXML(Variant, "Reads every value; absent amounts are 0. An amount that is no number raises "
                             "TypeMismatch (13).");
    VARNEX_PROPERTY(double, dTotalExcludingTax, TotalExcludingTax, "Total without tax, in dollars.");
    VARNEX_PROPERTY(double, dTotalTaxAmount, TotalTaxAmount, "Tax on the total, in dollars.");
    VARNEX_PROPERTY(double, dTotalIncludingTax, TotalIncludingTax, "Total with tax, in dollars.");
    VARNEX_PROPERTY(double, dExcessToCollect, ExcessToCollect, "Excess to collect from the owner, in dollars.");
    VARNEX_PROPERTY(Child<OwnersContributionToCollectDef>, objOwnersContributionToCollect, OwnersContributionToCollect,
                    "What the owner is to pay.");
    VARNEX_PROPERTY(double, dTotalPayableAmount, TotalPayableAmount, "What is to be paid, in dollars.");
    VARNEX_PROPERTY(double, dTaxRate, TaxRate, "Rate of the tax, in per cent.");
    VARNEX_RECORD_END;
};

} // namespace varnex3
