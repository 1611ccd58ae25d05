#include "varnex3/outcomes/Xalo_ReactivateInvoice.h"

namespace varnex3 {

VARNEX_DEFINE(Xalo_ReactivateInvoice);

void Xalo_ReactivateInvoice::Write(XmlWriter& xml) const
{
    xml.OpenMessage("Xalo_ReactivateInvoice");
    xml.Append(objVersionField, objSourceField, objDestinationField);
    xml.IfSet("MessageNo", sMessageNoField);
    xml.Append(objInsurerField, objRepairerField, objClaimHeaderField);
    xml.IfSet("QuoteNo", sQuoteNoField);
    xml.Append(objVehicleField);
    xml.IfSet("ReActivateInvoiceDate", dtReActivateInvoiceDateField);
    xml.Append(objPaymentDetailsField);
    xml.IfSet("OpenText", sOpenTextField);
    xml.CloseMessage("Xalo_ReactivateInvoice");
}

} // namespace varnex3
