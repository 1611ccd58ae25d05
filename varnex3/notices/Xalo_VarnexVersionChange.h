// The message that announces which versions are in force and which one comes next.
#pragma once

#include "varnex3/core/DestinationDef.h"
#include "varnex3/core/RepairerDef.h"
#include "varnex3/core/SourceDef.h"
#include "varnex3/notices/VersionChangeDef.h"

namespace varnex3 {

// It has no number. A text that is not well-formed reads as an empty document, so that the first section which requires
// an element, the source, raises ObjectNotSet (91).
class Xalo_VarnexVersionChange final : public Record
{
    VARNEX_RECORD(Xalo_VarnexVersionChange, "The notice of a change of version, the whole message.");
    VARNEX_SERIALISE("The message, from the XML declaration to the root's end tag and the line end behind it.");
    VARNEX_PARSEXML_OF_MESSAGE(Text,
                               "Reads every section and gives the message written again. What a section raises ends "
                               "it: the sections before are read, those behind stay as they were. Fields of the "
                               "repairer are appended to.");
    VARNEX_PROPERTY(Child<VersionChangeDef>, objVersionField, VersionField, "The versions.");
    VARNEX_PROPERTY(Child<SourceDef>, objSourceField, SourceField, "Who sent the message, and when.");
    VARNEX_PROPERTY(Child<DestinationDef>, objDestinationField, DestinationField, "Whom it is sent to.");
    VARNEX_PROPERTY(Child<RepairerDef>, objRepairerField, RepairerField, "The repairer.");
    static constexpr int kLevel = 0;
    VARNEX_RECORD_END;
};

} // namespace varnex3
