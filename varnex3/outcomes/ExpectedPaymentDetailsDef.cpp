#include "varnex3/outcomes/ExpectedPaymentDetailsDef.h"

namespace varnex3 {

VARNEX_DEFINE(ExpectedPaymentDetailsDef);

void ExpectedPaymentDetailsDef::Write(XmlWriter& xml) const
{
    // The owner's contribution alone does not cause the element.
    const bool isWritten = dTotalExcludingTax > 0 || dTotalTaxAmount > 0 || dTotalIncludingTax > 0
                           || dExcessToCollect > 0 || dTotalPayableAmount > 0 || dTaxRate > 0;
    if (!isWritten)
        return;

    xml.Open("ExpectedPaymentDetails");
    xml.IfPositive("TotalExcludingTax", dTotalExcludingTax);
    xml.IfPositive("TotalTaxAmount", dTotalTaxAmount);
    xml.IfPositive("TotalIncludingTax", dTotalIncludingTax);
    xml.IfPositive("ExcessToCollect", dExcessToCollect);
    xml.Append(objOwnersContributionToCollect);
    xml.IfPositive("TotalPayableAmount", dTotalPayableAmount);
    xml.IfPositive("TaxRate", dTaxRate);
    xml.Close("ExpectedPaymentDetails");
}

void ExpectedPaymentDetailsDef::Read(const XmlSection& section)
{
    dTotalExcludingTax = section.NumberAt("ExpectedPaymentDetails/TotalExcludingTax");
    dTotalTaxAmount = section.NumberAt("ExpectedPaymentDetails/TotalTaxAmount");
    dTotalIncludingTax = section.NumberAt("ExpectedPaymentDetails/TotalIncludingTax");
    dExcessToCollect = section.NumberAt("ExpectedPaymentDetails/ExcessToCollect");
    section.ReadInto(objOwnersContributionToCollect, "ExpectedPaymentDetails/OwnersContributionToCollect");
    dTotalPayableAmount = section.NumberAt("ExpectedPaymentDetails/TotalPayableAmount");
    dTaxRate = section.NumberAt("ExpectedPaymentDetails/TaxRate");
}

} // namespace varnex3
