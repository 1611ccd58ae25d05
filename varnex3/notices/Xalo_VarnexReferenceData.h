// The message that delivers reference data.
#pragma once

#include "varnex3/core/DestinationDef.h"
#include "varnex3/core/RepairerOptDef.h"
#include "varnex3/core/SourceDef.h"
#include "varnex3/core/VersionDef.h"
#include "varnex3/notices/ReferenceDataDef.h"

namespace varnex3 {

// It has no number. A text that is not well-formed reads as an empty document, so that the first section which requires
// an element, the source, raises ObjectNotSet (91).
class Xalo_VarnexReferenceData final : public Record
{
    VARNEX_RECORD(Xalo_VarnexReferenceData, "A delivery of reference data, the whole message.");
    VARNEX_SERIALISE("The message, from the XML declaration to the root's end tag, without a line end behind it.");
    VARNEX_PARSEXML_OF_MESSAGE(Text,
                               "Reads every section and gives the message written again. What a section raises ends "
                               "it: the sections before are read, those behind stay as they were. Data types and "
                               "fields of the repairer are appended to.");
    VARNEX_PROPERTY(Child<ReferenceDataDef>, objReferenceDataField, ReferenceDataField,
                    "The reference data; written behind the envelope.");
    VARNEX_PROPERTY(Child<VersionDef>, objVersionField, VersionField, "Version of the message language.");
    VARNEX_PROPERTY(Child<SourceDef>, objSourceField, SourceField, "Who sent the message, and when.");
    VARNEX_PROPERTY(Child<DestinationDef>, objDestinationField, DestinationField, "Whom it is sent to.");
    VARNEX_PROPERTY(Child<RepairerOptDef>, objRepairerField, RepairerField, "The repairer.");
    static constexpr int kLevel = 0;
    VARNEX_RECORD_END;
};

} // namespace varnex3
