// The message with which a repairer asks for an invoice to be taken up again.
#pragma once

#include "varnex3/core/ClaimHeaderDef.h"
#include "varnex3/core/DestinationDef.h"
#include "varnex3/core/InsurerOptDef.h"
#include "varnex3/core/RepairerDef.h"
#include "varnex3/core/SourceDef.h"
#include "varnex3/core/VehicleDef.h"
#include "varnex3/core/VersionDef.h"
#include "varnex3/outcomes/PaymentDetailsDef.h"

namespace varnex3 {

class Xalo_ReactivateInvoice final : public Record
{
    VARNEX_RECORD(Xalo_ReactivateInvoice,
                  "A repairer's request to reactivate an invoice, the whole message. It can be written only.");
    VARNEX_SERIALISE("The message, from the XML declaration to the root's end tag and the line end behind it.");
    VARNEX_PROPERTY(Child<VersionDef>, objVersionField, VersionField, "Version of the message language.");
    VARNEX_PROPERTY(Child<SourceDef>, objSourceField, SourceField, "Who sent the message, and when.");
    VARNEX_PROPERTY(Child<DestinationDef>, objDestinationField, DestinationField, "Whom it is sent to.");
    VARNEX_PROPERTY(Text, sMessageNoField, MessageNoField, "Number of the message; written as it is when not empty.");
    VARNEX_PROPERTY(Child<InsurerOptDef>, objInsurerField, InsurerField, "The insurer.");
    VARNEX_PROPERTY(Child<RepairerDef>, objRepairerField, RepairerField, "The repairer.");
    VARNEX_PROPERTY(Text, sQuoteNoField, QuoteNoField, "Number of the quote; written as it is when not empty.");
    VARNEX_PROPERTY(Child<VehicleDef>, objVehicleField, VehicleField, "The vehicle.");
    VARNEX_PROPERTY(Date, dtReActivateInvoiceDateField, ReActivateInvoiceDateField,
                    "When the invoice is reactivated; written as a day, left out when it is the zero date.");
    VARNEX_PROPERTY(Child<PaymentDetailsDef>, objPaymentDetailsField, PaymentDetailsField,
                    "The figures of the invoice.");
    VARNEX_PROPERTY(Text, sOpenTextField, OpenTextField, "Free text; written as it is when not empty.");
    VARNEX_PROPERTY(Child<ClaimHeaderDef>, objClaimHeaderField, ClaimHeaderField,
                    "Claim and vehicle by their numbers.");
    static constexpr int kLevel = 0;
    VARNEX_RECORD_END;
};

} // namespace varnex3
