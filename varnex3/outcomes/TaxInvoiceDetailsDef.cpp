#include "varnex3/outcomes/TaxInvoiceDetailsDef.h"

namespace varnex3 {

VARNEX_DEFINE(TaxInvoiceDetailsDef);

void TaxInvoiceDetailsDef::Write(XmlWriter& xml) const
{
    if (!bTaxInvoice)
        return;

    xml.Open("TaxInvoiceDetail");
    xml.Flag("TaxInvoice", bTaxInvoice);
    xml.IfSet("CompletionDate", dtCompletionDate);
    xml.IfSet("Description", sDescription);
    xml.Close("TaxInvoiceDetail");
}

} // namespace varnex3
