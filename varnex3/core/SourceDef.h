// Who sent a message, with which program, and when.
#pragma once

#include "varnex3/core/Rows.h"

namespace varnex3 {

class SourceDef final : public Record
{
    VARNEX_RECORD(SourceDef, "The sender of a message: organisation, application and time stamp.");
    VARNEX_SERIALISE("The Source group, always written whole.");
    VARNEX_PARSEXML(Variant, "Reads every value; an absent element raises ObjectNotSet (91), a time stamp that is no "
                             "date TypeMismatch (13). Its zone is dropped.");
    VARNEX_PROPERTY(Text, sOrgType, OrgType,
                    "Organisation type of the sender: INS an insurer, REP a repairer; not checked.");
    VARNEX_PROPERTY(Text, sAppVersion, AppVersion, "Version of the sending application.");
    VARNEX_PROPERTY(Text, sAppName, AppName, "Name of the sending application.");
    VARNEX_PROPERTY(Date, dtTimeStamp, TimeStamp, "When the message was made, local time; written to the second.");
    VARNEX_RECORD_END;
};

} // namespace varnex3
