// The message that cancels a job.
#pragma once

#include "varnex3/core/ClaimHeaderDef.h"
#include "varnex3/core/DestinationDef.h"
#include "varnex3/core/InsurerDef.h"
#include "varnex3/core/RepairerOptDef.h"
#include "varnex3/core/SourceDef.h"
#include "varnex3/core/VersionDef.h"

namespace varnex3 {

// A text that is not well-formed reads as an empty document, so that the first section which requires an element, the
// source, raises ObjectNotSet (91).
class Xalo_JobCancelled final : public Record
{
    VARNEX_RECORD(Xalo_JobCancelled, "The cancellation of a job, the whole message.");
    VARNEX_SERIALISE("The message, from the XML declaration to the root's end tag, without a line end behind it.");
    VARNEX_PARSEXML_OF_MESSAGE(
        Text, "Reads every section and gives the message written again. What a section raises ends it: the sections "
              "before are read, those behind stay as they were. Fields of the parties are appended to.");
    VARNEX_PROPERTY(Child<VersionDef>, objVersionField, VersionField, "Version of the message language.");
    VARNEX_PROPERTY(Child<SourceDef>, objSourceField, SourceField, "Who sent the message, and when.");
    VARNEX_PROPERTY(Child<DestinationDef>, objDestinationField, DestinationField, "Whom it is sent to.");
    VARNEX_PROPERTY(Text, sMessageNoField, MessageNoField, "Number of the message; always written, as it is.");
    VARNEX_PROPERTY(Child<InsurerDef>, objInsurerField, InsurerField, "The insurer.");
    VARNEX_PROPERTY(Child<RepairerOptDef>, objRepairerField, RepairerField, "The repairer.");
    VARNEX_PROPERTY(Child<ClaimHeaderDef>, objClaimHeaderField, ClaimHeaderField,
                    "Claim and vehicle by their numbers.");
    VARNEX_PROPERTY(Text, sQuoteNoField, QuoteNoField, "Number of the quote; written as it is when not empty.");
    VARNEX_PROPERTY(Text, sReasonField, ReasonField, "Why the job is cancelled; written as it is when not empty.");
    static constexpr int kLevel = 0;
    VARNEX_RECORD_END;
};

} // namespace varnex3
