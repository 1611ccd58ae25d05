#include "varnex3/outcomes/Xalo_PaymentAuthorised.h"

namespace varnex3 {

VARNEX_DEFINE(Xalo_PaymentAuthorised);

void Xalo_PaymentAuthorised::Write(XmlWriter& xml) const
{
    xml.OpenMessage("Xalo_PaymentAuthorised");
    xml.Append(objVersionField, objSourceField, objDestinationField);
    xml.Always("MessageNo", sMessageNoField);
    xml.Append(objInsurerField, objRepairerField, objClaimHeaderField);
    xml.Always("QuoteNo", sQuoteNoField);
    xml.Append(objVehicleField, objPayAuthorityDetailsField);
    xml.CloseMessageWithoutLineEnd("Xalo_PaymentAuthorised");
}

void Xalo_PaymentAuthorised::Read(const XmlSection& section)
{
    section.ReadInto(objVersionField, "Xalo_PaymentAuthorised/Version");
    section.ReadInto(objSourceField, "Xalo_PaymentAuthorised/Source");
    section.ReadInto(objDestinationField, "Xalo_PaymentAuthorised/Destination");
    sMessageNoField = section.TextAt("Xalo_PaymentAuthorised/MessageNo");
    section.ReadInto(objInsurerField, "Xalo_PaymentAuthorised/Insurer");
    section.ReadInto(objRepairerField, "Xalo_PaymentAuthorised/Repairer");
    section.ReadInto(objClaimHeaderField, "Xalo_PaymentAuthorised/ClaimHeader");
    sQuoteNoField = section.TextAt("Xalo_PaymentAuthorised/QuoteNo");
    section.ReadInto(objVehicleField, "Xalo_PaymentAuthorised/Vehicle");
    section.ReadInto(objPayAuthorityDetailsField, "Xalo_PaymentAuthorised/PayAuthorityDetails");
}

} // namespace varnex3
