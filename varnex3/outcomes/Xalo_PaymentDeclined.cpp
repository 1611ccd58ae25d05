#include "varnex3/outcomes/Xalo_PaymentDeclined.h"

namespace varnex3 {

VARNEX_DEFINE(Xalo_PaymentDeclined);

void Xalo_PaymentDeclined::Write(XmlWriter& xml) const
{
    xml.OpenMessage("Xalo_PaymentDeclined");
    xml.Append(objVersionField, objSourceField, objDestinationField);
    xml.Always("MessageNo", sMessageNoField);
    xml.Append(objInsurerField, objRepairerField, objClaimHeaderField);
    xml.IfSet("QuoteNo", sQuoteNoField);
    xml.Append(objVehicleField, objLastInvoiceDetailsField, objExpectedPaymentDetailsField);
    xml.IfSet("Reason", sReasonField);
    xml.CloseMessageWithoutLineEnd("Xalo_PaymentDeclined");
}

void Xalo_PaymentDeclined::Read(const XmlSection& section)
{
    section.ReadInto(objVersionField, "Xalo_PaymentDeclined/Version");
    section.ReadInto(objSourceField, "Xalo_PaymentDeclined/Source");
    section.ReadInto(objDestinationField, "Xalo_PaymentDeclined/Destination");
    sMessageNoField = section.TextAt("Xalo_PaymentDeclined/MessageNo");
    section.ReadInto(objInsurerField, "Xalo_PaymentDeclined/Insurer");
    section.ReadInto(objRepairerField, "Xalo_PaymentDeclined/Repairer");
    section.ReadInto(objClaimHeaderField, "Xalo_PaymentDeclined/ClaimHeader");
    sQuoteNoField = section.TextAt("Xalo_PaymentDeclined/QuoteNo");
    section.ReadInto(objVehicleField, "Xalo_PaymentDeclined/Vehicle");
    section.ReadInto(objLastInvoiceDetailsField, "Xalo_PaymentDeclined/LastInvoiceDetails");
    section.ReadInto(objExpectedPaymentDetailsField, "Xalo_PaymentDeclined/ExpectedPaymentDetails");
    sReasonField = section.TextAt("Xalo_PaymentDeclined/Reason");
}

} // namespace varnex3
