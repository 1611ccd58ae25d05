// What the insurer pays of an invoice.
#pragma once

#include "varnex3/core/Rows.h"

namespace varnex3 {

class PayAuthorityDetailsDef final : public Record
{
    VARNEX_RECORD(PayAuthorityDetailsDef, "Which invoice is to be paid, how much of it, and since when.");
    VARNEX_SERIALISE("The PayAuthorityDetails group with the values that are set, an amount when it is greater than 0; "
                     "nothing when none is.");
    VARNEX_PARSEXML(Variant,
                    "Reads every value; absent elements give the empty text and 0, but an absent or empty date "
                    "leaves PayAuthorisedDate as it was. Text that is no date or no number raises "
                    "TypeMismatch (13).");
    VARNEX_PROPERTY(Text, sRepairerTaxInvoiceNo, RepairerTaxInvoiceNo, "The repairer's number of the invoice.");
    VARNEX_PROPERTY(Date, dtPayAuthorisedDate, PayAuthorisedDate,
                    "When payment was authorised; written as a day, read with the time of day.");
    VARNEX_PROPERTY(double, dPaymentAmount, PaymentAmount, "What is paid, in dollars.");
    VARNEX_RECORD_END;
};

} // namespace varnex3
