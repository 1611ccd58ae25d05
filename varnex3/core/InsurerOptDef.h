// The insurer of a job, where the group is always written.
#pragma once

#include "varnex3/core/InsurerDetailDef.h"

namespace varnex3 {

class InsurerOptDef final : public Record
{
    VARNEX_RECORD(InsurerOptDef,
                  "The insurer of a job, in the messages that a repairer sends; written only, never read.");
    VARNEX_SERIALISE("The Insurer group, with an empty element when empty.");
    VARNEX_PROPERTY(Text, sUnderwriterName, UnderwriterName, "Name of the underwriter; written as it is.");
    VARNEX_PROPERTY_GET(Child<InsurerDetailDef>, objInsurerDetail, InsurerDetail,
                        "Further named fields; empty values are written too.");
    VARNEX_RECORD_END;
};

} // namespace varnex3
