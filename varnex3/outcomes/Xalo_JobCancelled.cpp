#include "varnex3/outcomes/Xalo_JobCancelled.h"

namespace varnex3 {

VARNEX_DEFINE(Xalo_JobCancelled);

void Xalo_JobCancelled::Write(XmlWriter& xml) const
{
    xml.OpenMessage("Xalo_JobCancelled");
    xml.Append(objVersionField, objSourceField, objDestinationField);
    xml.Always("MessageNo", sMessageNoField);
    xml.Append(objInsurerField, objRepairerField, objClaimHeaderField);
    xml.IfSet("QuoteNo", sQuoteNoField);
    xml.IfSet("Reason", sReasonField);
    xml.CloseMessageWithoutLineEnd("Xalo_JobCancelled");
}

void Xalo_JobCancelled::Read(const XmlSection& section)
{
    section.ReadInto(objVersionField, "Xalo_JobCancelled/Version");
    section.ReadInto(objSourceField, "Xalo_JobCancelled/Source");
    section.ReadInto(objDestinationField, "Xalo_JobCancelled/Destination");
    sMessageNoField = section.TextAt("Xalo_JobCancelled/MessageNo");
    section.ReadInto(objInsurerField, "Xalo_JobCancelled/Insurer");
    section.ReadInto(objRepairerField, "Xalo_JobCancelled/Repairer");
    section.ReadInto(objClaimHeaderField, "Xalo_JobCancelled/ClaimHeader");
    sQuoteNoField = section.TextAt("Xalo_JobCancelled/QuoteNo");
    sReasonField = section.TextAt("Xalo_JobCancelled/Reason");
}

} // namespace varnex3
