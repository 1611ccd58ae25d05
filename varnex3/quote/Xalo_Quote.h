// The message with which a repairer quotes for a job, and with which the insurer answers.
#pragma once

#include "varnex3/core/ClaimHeaderDef.h"
#include "varnex3/core/CustomerDef.h"
#include "varnex3/core/DestinationDef.h"
#include "varnex3/core/InsurerDef.h"
#include "varnex3/core/RepairerDef.h"
#include "varnex3/core/SourceDef.h"
#include "varnex3/core/VehicleDef.h"
#include "varnex3/core/VersionDef.h"
#include "varnex3/quote/AssessmentDef.h"
#include "varnex3/quote/HourlyRatesDef.h"
#include "varnex3/quote/InspectionDef.h"
#include "varnex3/quote/QuoteDetailsDef.h"
#include "varnex3/quote/QuoteItemsDef.h"
#include "varnex3/quote/TotalsDef.h"
#include "varnex3/quote/VarnexStatusDef.h"
#include "varnex3/quote/VehicleDetailsDef.h"

namespace varnex3 {

// A text that is not well-formed reads as an empty document, so that the first section which requires an element, the
// source, raises ObjectNotSet (91).
class Xalo_Quote final : public Record
{
    VARNEX_RECORD(Xalo_Quote, "A repairer's quote for a job, the whole message.");
    VARNEX_SERIALISE("The message, from the XML declaration to the root's end tag and the line end behind it.");
    VARNEX_PARSEXML_OF_MESSAGE(Variant,
                               "Reads every section and gives the message written again. What a section raises ends "
                               "it: the sections before are read, those behind stay as they were. A missing QuoteDate "
                               "raises TypeMismatch (13). Lists are appended to. The inspection does not come back: "
                               "it is looked for as Inspection, but written as InspectionReqested.");
    VARNEX_PROPERTY(Child<VersionDef>, objVersionField, VersionField, "Version of the message language.");
    VARNEX_PROPERTY(Child<SourceDef>, objSourceField, SourceField, "Who sent the message, and when.");
    VARNEX_PROPERTY(Child<DestinationDef>, objDestinationField, DestinationField, "Whom it is sent to.");
    VARNEX_PROPERTY(Text, sMessageNoField, MessageNoField, "Number of the message; always written, as it is.");
    VARNEX_PROPERTY(Child<InsurerDef>, objInsurerField, InsurerField, "The insurer.");
    VARNEX_PROPERTY(Child<RepairerDef>, objRepairerField, RepairerField, "The repairer.");
    VARNEX_PROPERTY(Child<ClaimHeaderDef>, objClaimHeaderField, ClaimHeaderField,
                    "Claim and vehicle by their numbers.");
    VARNEX_PROPERTY(Text, sQuoteNoField, QuoteNoField, "Number of the quote; written as it is when not empty.");
    VARNEX_PROPERTY(Date, dtQuoteDateField, QuoteDateField,
                    "Date of the quote; left out when it is the zero date, and then not read back.");
    VARNEX_PROPERTY(Child<VarnexStatusDef>, objVarnexStatusField, VarnexStatusField, "How far the quote has come.");
    VARNEX_PROPERTY(Child<InspectionDef>, objInspectionReqestedField, InspectionReqestedField,
                    "Request for an inspection; the name is spelled so.");
    VARNEX_PROPERTY(Child<QuoteDetailsDef>, objQuoteDetailsField, QuoteDetailsField, "Kind, dates and excess.");
    VARNEX_PROPERTY(Child<VehicleDef>, objVehicleField, VehicleField, "The vehicle.");
    VARNEX_PROPERTY(Child<VehicleDetailsDef>, objVehicleDetailsField, VehicleDetailsField,
                    "What the repairer knows of the vehicle.");
    VARNEX_PROPERTY(Child<HourlyRatesDef>, objHourlyRatesField, HourlyRatesField, "The repairer's hourly rates.");
    VARNEX_PROPERTY(Text, sDefinesField, DefinesField, "Definitions for the receiver; written as they are.");
    VARNEX_PROPERTY(Child<QuoteItemsDef>, objQuoteItemsField, QuoteItemsField, "The items of the quote.");
    VARNEX_PROPERTY(Child<TotalsDef>, objTotalsField, TotalsField, "What the quote comes to.");
    VARNEX_PROPERTY(Child<AssessmentDef>, objAssessmentField, AssessmentField, "The insurer's assessment.");
    VARNEX_PROPERTY(Child<CustomerDef>, objCustomerField, CustomerField, "The customer.");
    VARNEX_PROPERTY(std::int16_t, iImageCountField, ImageCountField, "Number of images of the job; always written.");
    static constexpr int kLevel = 0;
    VARNEX_RECORD_END;
};

} // namespace varnex3
