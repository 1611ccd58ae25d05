// The insurer of a job, where it may be left out.
#pragma once

#include "varnex3/core/InsurerDetailDef.h"

namespace varnex3 {

class InsurerDef final : public Record
{
    VARNEX_RECORD(InsurerDef, "The insurer of a job.");
    VARNEX_SERIALISE(
        "The Insurer group; nothing when the underwriter's name is empty, whatever further fields there are.");
    VARNEX_PARSEXML(Variant,
                    "Reads the underwriter's name, which must be there (91), and appends the further fields; one "
                    "that is there already raises DuplicateKey (457).");
    VARNEX_PROPERTY(Text, sUnderwriterName, UnderwriterName, "Name of the underwriter; written as it is.");
    VARNEX_PROPERTY_GET(Child<InsurerDetailDef>, objInsurerDetail, InsurerDetail,
                        "Further named fields; empty values are not written.");
    VARNEX_RECORD_END;
};

} // namespace varnex3
