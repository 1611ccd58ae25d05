#include "varnex3/quote/AssessmentDef.h"

namespace varnex3 {

VARNEX_DEFINE(AssessmentDef);

void AssessmentDef::Write(XmlWriter& xml) const
{
    const bool isWritten = IsSet(dtAssessmentDate) || IsSet(sAssessorName) || IsSet(sAssessorPhone)
                           || IsSet(sAssessorMobile) || IsSet(sAssessorFax) || IsSet(sAssessorEmail);
    if (!isWritten)
        return;

    xml.Open("Assessment");
    xml.IfSet("AssessmentDate", dtAssessmentDate);
    xml.IfSet("AssessorName", sAssessorName);
    xml.IfSet("AssessorPhone", sAssessorPhone);
    xml.IfSet("AssessorMobile", sAssessorMobile);
    xml.IfSet("AssessorFax", sAssessorFax);
    xml.IfSet("AssessorEmail", sAssessorEmail);
    xml.Close("Assessment");
}

void AssessmentDef::Read(const XmlSection& section)
{
    dtAssessmentDate =
        section.TimestampAt("Assessment/AssessmentDate", dtAssessmentDate); // an empty one changes nothing
    sAssessorName = section.TextAt("Assessment/AssessorName");
    sAssessorPhone = section.TextAt("Assessment/AssessorPhone");
    sAssessorMobile = section.TextAt("Assessment/AssessorMobile");
    sAssessorFax = section.TextAt("Assessment/AssessorFax");
    sAssessorEmail = section.TextAt("Assessment/AssessorEmail");
}

} // namespace varnex3
