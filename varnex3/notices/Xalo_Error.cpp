#include "varnex3/notices/Xalo_Error.h"

namespace varnex3 {

VARNEX_DEFINE(Xalo_Error);

void Xalo_Error::Write(XmlWriter& xml) const
{
    xml.OpenMessage("Xalo_Error");
    xml.Append(objVersionField, objSourceField, objDestinationField);
    xml.IfSet("RelatesToMessageNo", sRelatesToMessageNoField);
    xml.Append(objInsurerField, objRepairerField, objClaimHeaderField);
    xml.IfSet("QuoteNo", sQuoteNoField);
    xml.Append(objErrorDetailsField);
    xml.CloseMessage("Xalo_Error");
}

void Xalo_Error::Read(const XmlSection& section)
{
    section.ReadInto(objVersionField, "Xalo_Error/Version");
    section.ReadInto(objSourceField, "Xalo_Error/Source");
    section.ReadInto(objDestinationField, "Xalo_Error/Destination");
    section.ReadInto(objInsurerField, "Xalo_Error/Insurer");
    section.ReadInto(objRepairerField, "Xalo_Error/Repairer");
    section.ReadInto(objClaimHeaderField, "Xalo_Error/ClaimHeader");
    sRelatesToMessageNoField = section.TextAt("Xalo_Error/RelatesToMessageNo"); // behind the sections
    sQuoteNoField = section.TextAt("Xalo_Error/QuoteNo");
    for (const xml::Node& details : section.NodesAt("Xalo_Error/ErrorDetails"))
        objErrorDetailsField->Read(XmlSection(details, ErrorDetailsDef::ClassName));
}

} // namespace varnex3
