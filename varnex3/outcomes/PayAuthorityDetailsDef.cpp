#include "varnex3/outcomes/PayAuthorityDetailsDef.h"

namespace varnex3 {

VARNEX_DEFINE(PayAuthorityDetailsDef);

void PayAuthorityDetailsDef::Write(XmlWriter& xml) const
{
    const bool isWritten = IsSet(sRepairerTaxInvoiceNo) || IsSet(dtPayAuthorisedDate) || dPaymentAmount > 0;
    if (!isWritten)
        return;

    xml.Open("PayAuthorityDetails");
    xml.IfSet("RepairerTaxInvoiceNo", sRepairerTaxInvoiceNo);
    xml.IfSet("PayAuthorisedDate", dtPayAuthorisedDate);
    xml.IfPositive("PaymentAmount", dPaymentAmount);
    xml.Close("PayAuthorityDetails");
}

void PayAuthorityDetailsDef::Read(const XmlSection& section)
{
    sRepairerTaxInvoiceNo = section.TextAt("PayAuthorityDetails/RepairerTaxInvoiceNo");
    dtPayAuthorisedDate = section.TimestampAt("PayAuthorityDetails/PayAuthorisedDate", dtPayAuthorisedDate);
    dPaymentAmount = section.NumberAt("PayAuthorityDetails/PaymentAmount");
}

} // namespace varnex3
