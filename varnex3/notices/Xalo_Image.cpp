#include "varnex3/notices/Xalo_Image.h"

namespace varnex3 {

VARNEX_DEFINE(Xalo_Image);

void Xalo_Image::Write(XmlWriter& xml) const
{
    xml.OpenMessage("Xalo_Image");
    xml.Append(objVersionField, objSourceField, objDestinationField);
    xml.IfSet("MessageNo", sMessageNoField);
    xml.Append(objInsurerField, objRepairerField, objClaimHeaderField);
    xml.IfSet("QuoteNo", sQuoteNoField);
    xml.IfSet("RegistrationNo", sRegistrationNoField);
    xml.IfSet("ImageNo", sImageNoField); // before the open text, although it is listed behind it
    xml.IfSet("OpenText", sOpenTextField);
    xml.CloseMessage("Xalo_Image");
}

} // namespace varnex3
