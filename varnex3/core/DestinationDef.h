// Whom a message is for.
#pragma once

#include "varnex3/core/Rows.h"

namespace varnex3 {

class DestinationDef final : public Record
{
    VARNEX_RECORD(DestinationDef, "The recipient of a message.");
    VARNEX_SERIALISE("The Destination group, always written.");
    VARNEX_PARSEXML(Variant, "Reads the organisation type; an absent one raises ObjectNotSet (91).");
    VARNEX_PROPERTY(Text, sOrgType, OrgType,
                    "Organisation type of the recipient: INS an insurer, REP a repairer; not checked.");
    VARNEX_RECORD_END;
};

} // namespace varnex3
