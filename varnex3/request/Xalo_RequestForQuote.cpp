#include "varnex3/request/Xalo_RequestForQuote.h"

namespace varnex3 {

VARNEX_DEFINE(Xalo_RequestForQuote);

void Xalo_RequestForQuote::Write(XmlWriter& xml) const
{
    xml.OpenMessage("Xalo_RequestForQuote");
    xml.Append(objVersionField);
    xml.Append(objSourceField);
    xml.Append(objDestinationField);
    xml.Always("MessageNo", sMessageNoField);
    xml.Append(objInsurerField);
    xml.Append(objRepairerField);
    xml.Append(objClaimHeaderField);
    xml.Append(objRequestDetailsField);
    xml.Append(objVehicleField);
    xml.Append(objVehicleModsField);
    xml.Append(objCustomerField);
    xml.CloseMessageWithoutLineEnd("Xalo_RequestForQuote");
}

void Xalo_RequestForQuote::Read(const XmlSection& section)
{
    section.ReadInto(objVersionField, "Xalo_RequestForQuote/Version");
    section.ReadInto(objSourceField, "Xalo_RequestForQuote/Source");
    section.ReadInto(objDestinationField, "Xalo_RequestForQuote/Destination");
    sMessageNoField = section.TextAt("Xalo_RequestForQuote/MessageNo");
    section.ReadInto(objInsurerField, "Xalo_RequestForQuote/Insurer");
    section.ReadInto(objRepairerField, "Xalo_RequestForQuote/Repairer");
    section.ReadInto(objClaimHeaderField, "Xalo_RequestForQuote/ClaimHeader");
    section.ReadInto(objRequestDetailsField, "Xalo_RequestForQuote/RequestDetails");
    section.ReadInto(objVehicleField, "Xalo_RequestForQuote/Vehicle");
    section.ReadInto(objVehicleModsField, "Xalo_RequestForQuote/VehicleMods");
    section.ReadInto(objCustomerField, "Xalo_RequestForQuote/Customer");
}

} // namespace varnex3
