// The repairer of a job, where it may be left out.
#pragma once

#include "varnex3/core/InsurerDetailDef.h"

namespace varnex3 {

class RepairerDef final : public Record
{
    VARNEX_RECORD(RepairerDef, "The repairer of a job.");
    VARNEX_SERIALISE(
        "The Repairer group; nothing when identifier and name are both empty, whatever further fields there are.");
    VARNEX_PARSEXML(Variant, "Reads identifier and name, which must be there (91), and appends the further fields; one "
                             "that is there already raises DuplicateKey (457).");
    VARNEX_PROPERTY(Text, sRepairerID, RepairerID, "Identifier of the repairer.");
    VARNEX_PROPERTY(Text, sRepairerName, RepairerName, "Name of the repairer; escaped when written.");
    VARNEX_PROPERTY_GET(Child<InsurerDetailDef>, objRepairerDetails, RepairerDetails,
                        "Further named fields; empty values are written too.");
    VARNEX_RECORD_END;
};

} // namespace varnex3
