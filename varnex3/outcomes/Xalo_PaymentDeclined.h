// The message with which an insurer declines the payment of an invoice.
#pragma once

#include "varnex3/core/ClaimHeaderDef.h"
#include "varnex3/core/DestinationDef.h"
#include "varnex3/core/InsurerDef.h"
#include "varnex3/core/RepairerOptDef.h"
#include "varnex3/core/SourceDef.h"
#include "varnex3/core/VehicleDef.h"
#include "varnex3/core/VersionDef.h"
#include "varnex3/outcomes/ExpectedPaymentDetailsDef.h"
#include "varnex3/outcomes/PaymentDetailsDef.h"

namespace varnex3 {

// A text that is not well-formed reads as an empty document, so that the first section which requires an element, the
// source, raises ObjectNotSet (91).
class Xalo_PaymentDeclined final : public Record
{
    using LastInvoiceDetails = Child<PaymentDetailsDef, &NewLastInvoiceDetails>;

    VARNEX_RECORD(Xalo_PaymentDeclined, "An insurer's refusal to pay an invoice, the whole message.");
    VARNEX_SERIALISE("The message, from the XML declaration to the root's end tag, without a line end behind it.");
    VARNEX_PARSEXML_OF_MESSAGE(
        Text, "Reads every section and gives the message written again. What a section raises ends it: the sections "
              "before are read, those behind stay as they were. Fields of the parties are appended to.");
    VARNEX_PROPERTY(Child<VehicleDef>, objVehicleField, VehicleField, "The vehicle.");
    VARNEX_PROPERTY(Child<VersionDef>, objVersionField, VersionField, "Version of the message language.");
    VARNEX_PROPERTY(Child<SourceDef>, objSourceField, SourceField, "Who sent the message, and when.");
    VARNEX_PROPERTY(Child<DestinationDef>, objDestinationField, DestinationField, "Whom it is sent to.");
    VARNEX_PROPERTY(Text, sMessageNoField, MessageNoField, "Number of the message; always written, as it is.");
    VARNEX_PROPERTY(Child<InsurerDef>, objInsurerField, InsurerField, "The insurer.");
    VARNEX_PROPERTY(Child<RepairerOptDef>, objRepairerField, RepairerField, "The repairer.");
    VARNEX_PROPERTY(Child<ClaimHeaderDef>, objClaimHeaderField, ClaimHeaderField,
                    "Claim and vehicle by their numbers.");
    VARNEX_PROPERTY(Text, sQuoteNoField, QuoteNoField, "Number of the quote; written as it is when not empty.");
    VARNEX_PROPERTY(LastInvoiceDetails, objLastInvoiceDetailsField, LastInvoiceDetailsField,
                    "The figures of the last invoice, of the type LastInvoiceDetails at first. Another record keeps "
                    "the type that it has.");
    VARNEX_PROPERTY(Child<ExpectedPaymentDetailsDef>, objExpectedPaymentDetailsField, ExpectedPaymentDetailsField,
                    "The figures that the insurer expected.");
    VARNEX_PROPERTY(Text, sReasonField, ReasonField, "Why payment is declined; written as it is when not empty.");
    static constexpr int kLevel = 0;
    VARNEX_RECORD_END;
};

} // namespace varnex3
