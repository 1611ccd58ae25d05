// The message that tells the sender of another message why it could not be accepted.
#pragma once

#include "varnex3/core/ClaimHeaderDef.h"
#include "varnex3/core/DestinationDef.h"
#include "varnex3/core/InsurerDef.h"
#include "varnex3/core/RepairerOptDef.h"
#include "varnex3/core/SourceDef.h"
#include "varnex3/core/VersionDef.h"
#include "varnex3/notices/ErrorDetailsDef.h"

namespace varnex3 {

// It has no number of its own. A text that is not well-formed reads as an empty document, so that the first section
// which requires an element, the source, raises ObjectNotSet (91).
class Xalo_Error final : public Record
{
    VARNEX_RECORD(Xalo_Error, "Why a message could not be accepted, the whole message.");
    VARNEX_SERIALISE("The message, from the XML declaration to the root's end tag and the line end behind it.");
    VARNEX_PARSEXML_OF_MESSAGE(Text,
                               "Reads the six sections, the two texts and the error details, and gives the message "
                               "written again. What a section raises ends it: the sections before are read, those "
                               "behind stay as they were. Error details and fields of the parties are appended to.");
    VARNEX_PROPERTY(Child<RepairerOptDef>, objRepairerField, RepairerField, "The repairer.");
    VARNEX_PROPERTY(Child<VersionDef>, objVersionField, VersionField, "Version of the message language.");
    VARNEX_PROPERTY(Child<SourceDef>, objSourceField, SourceField, "Who sent the message, and when.");
    VARNEX_PROPERTY(Child<DestinationDef>, objDestinationField, DestinationField, "Whom it is sent to.");
    VARNEX_PROPERTY(Text, sRelatesToMessageNoField, RelatesToMessageNoField,
                    "Number of the message that is not accepted; written as it is when not empty.");
    VARNEX_PROPERTY(Child<InsurerDef>, objInsurerField, InsurerField, "The insurer.");
    VARNEX_PROPERTY(Child<ClaimHeaderDef>, objClaimHeaderField, ClaimHeaderField,
                    "Claim and vehicle by their numbers.");
    VARNEX_PROPERTY(Text, sQuoteNoField, QuoteNoField, "Number of the quote; written as it is when not empty.");
    VARNEX_PROPERTY(Child<ErrorDetailsDef>, objErrorDetailsField, ErrorDetailsField, "What is wrong.");
    static constexpr int kLevel = 0;
    VARNEX_RECORD_END;
};

} // namespace varnex3
