// The message with which a repairer declines a job.
#pragma once

#include "varnex3/core/ClaimHeaderDef.h"
#include "varnex3/core/DestinationDef.h"
#include "varnex3/core/InsurerOptDef.h"
#include "varnex3/core/RepairerDef.h"
#include "varnex3/core/SourceDef.h"
#include "varnex3/core/VersionDef.h"
#include "varnex3/outcomes/DeclinedDetailDef.h"

namespace varnex3 {

class Xalo_Declined final : public Record
{
    VARNEX_RECORD(Xalo_Declined, "A repairer's refusal of a job, the whole message. It can be written only.");
    VARNEX_SERIALISE("The message, from the XML declaration to the root's end tag and the line end behind it.");
    VARNEX_PROPERTY(Child<VersionDef>, objVersionField, VersionField, "Version of the message language.");
    VARNEX_PROPERTY(Child<SourceDef>, objSourceField, SourceField, "Who sent the message, and when.");
    VARNEX_PROPERTY(Child<DestinationDef>, objDestinationField, DestinationField, "Whom it is sent to.");
    VARNEX_PROPERTY(Text, sMessageNoField, MessageNoField, "Number of the message; written as it is when not empty.");
    VARNEX_PROPERTY(Child<InsurerOptDef>, objInsurerField, InsurerField, "The insurer.");
    VARNEX_PROPERTY(Child<RepairerDef>, objRepairerField, RepairerField, "The repairer.");
    VARNEX_PROPERTY(Child<ClaimHeaderDef>, objClaimHeaderField, ClaimHeaderField,
                    "Claim and vehicle by their numbers.");
    VARNEX_PROPERTY(Text, sQuoteNoField, QuoteNoField, "Number of the quote; written as it is when not empty.");
    VARNEX_PROPERTY(Child<DeclinedDetailDef>, objDeclinedDetailField, DeclinedDetailField,
                    "When and why the job is declined.");
    VARNEX_PROPERTY(Text, sVehicleLocationField, VehicleLocationField,
                    "Where the vehicle is; written as it is when not empty.");
    static constexpr int kLevel = 0;
    VARNEX_RECORD_END;
};

} // namespace varnex3
