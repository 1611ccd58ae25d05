#include "varnex3/outcomes/Xalo_Declined.h"

namespace varnex3 {

VARNEX_DEFINE(Xalo_Declined);

void Xalo_Declined::Write(XmlWriter& xml) const
{
    xml.OpenMessage("Xalo_Declined");
    xml.Append(objVersionField, objSourceField, objDestinationField);
    xml.IfSet("MessageNo", sMessageNoField);
    xml.Append(objInsurerField, objRepairerField, objClaimHeaderField);
    xml.IfSet("QuoteNo", sQuoteNoField);
    xml.Append(objDeclinedDetailField);
    xml.IfSet("VehicleLocation", sVehicleLocationField);
    xml.CloseMessage("Xalo_Declined");
}

} // namespace varnex3
