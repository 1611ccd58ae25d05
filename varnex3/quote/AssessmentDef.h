// The insurer's assessment of the damage.
#pragma once

#include "varnex3/core/Rows.h"

namespace varnex3 {

class AssessmentDef final : public Record
{
    VARNEX_RECORD(AssessmentDef, "When the insurer assesses the damage, and who does it.");
    VARNEX_SERIALISE("The Assessment group with the values that are not empty; nothing when all are. Nothing is "
                     "escaped.");
    VARNEX_PARSEXML(Text, "Reads every value. An absent or empty date leaves the date as it was, an absent text gives "
                          "the empty one. Text that is no date raises TypeMismatch (13).");
    VARNEX_PROPERTY(Date, dtAssessmentDate, AssessmentDate, "When; the day alone is written.");
    VARNEX_PROPERTY(Text, sAssessorName, AssessorName, "Name of the assessor.");
    VARNEX_PROPERTY(Text, sAssessorPhone, AssessorPhone, "Telephone number of the assessor.");
    VARNEX_PROPERTY(Text, sAssessorMobile, AssessorMobile, "Mobile telephone number of the assessor.");
    VARNEX_PROPERTY(Text, sAssessorFax, AssessorFax, "Fax number of the assessor.");
    VARNEX_PROPERTY(Text, sAssessorEmail, AssessorEmail, "Email address of the assessor.");
    VARNEX_RECORD_END;
};

} // namespace varnex3
