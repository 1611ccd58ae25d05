// When and why a repairer declined a job.
#pragma once

#include "varnex3/core/Rows.h"

namespace varnex3 {

class DeclinedDetailDef final : public Record
{
    VARNEX_RECORD(DeclinedDetailDef, "When and why a repairer declined a job.");
    VARNEX_SERIALISE("The DeclinedDetail group; nothing unless there are both a date and a reason.");
    VARNEX_PROPERTY(Date, dtDeclinedDate, DeclinedDate, "When the job was declined; written as a day.");
    VARNEX_PROPERTY(Text, sReasonText, ReasonText, "Why; written as it is.");
    VARNEX_RECORD_END;
};

} // namespace varnex3
