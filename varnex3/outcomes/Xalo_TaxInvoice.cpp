#include "varnex3/outcomes/Xalo_TaxInvoice.h"

namespace varnex3 {

VARNEX_DEFINE(Xalo_TaxInvoice);

void Xalo_TaxInvoice::Write(XmlWriter& xml) const
{
    xml.OpenMessage("Xalo_TaxInvoice");
    xml.Append(objVersionField, objSourceField, objDestinationField);
    xml.IfSet("MessageNo", sMessageNoField);
    xml.Append(objInsurerField, objRepairerField, objClaimHeaderField);
    xml.IfSet("QuoteNo", sQuoteNoField);
    xml.Append(objVehicleField, objTaxInvoiceDetail, objPaymentDetailsField);
    xml.IfSet("OpenText", sOpenTextField);
    xml.CloseMessage("Xalo_TaxInvoice");
}

} // namespace varnex3
