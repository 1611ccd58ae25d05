// The repairer of a job, where the group is always written.
#pragma once

#include "varnex3/core/InsurerDetailDef.h"

namespace varnex3 {

class RepairerOptDef final : public Record
{
    VARNEX_RECORD(RepairerOptDef, "The repairer of a job, in the messages that always carry the group.");
    VARNEX_SERIALISE("The Repairer group, with empty elements when empty.");
    VARNEX_PARSEXML(Variant, "Reads identifier and name, which must be there (91), and appends the further fields; one "
                             "that is there already raises DuplicateKey (457).");
    VARNEX_PROPERTY(Text, sRepairerID, RepairerID, "Identifier of the repairer.");
    VARNEX_PROPERTY(Text, sRepairerName, RepairerName, "Name of the repairer; written as it is.");
    VARNEX_PROPERTY(Child<InsurerDetailDef>, objRepairerDetails, RepairerDetails,
                    "Further named fields; empty values are written too.");
    VARNEX_RECORD_END;
};

} // namespace varnex3
