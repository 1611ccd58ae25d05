// What a tax invoice says of the work.
#pragma once

#include "varnex3/core/Rows.h"

namespace varnex3 {

class TaxInvoiceDetailsDef final : public Record
{
    VARNEX_RECORD(TaxInvoiceDetailsDef, "That the message is a tax invoice, and for what.");
    VARNEX_SERIALISE("The TaxInvoiceDetail group; nothing when TaxInvoice is False, whatever the other values.");
    VARNEX_PROPERTY(bool, bTaxInvoice, TaxInvoice,
                    "Whether the message is a tax invoice; written as an empty element.");
    VARNEX_PROPERTY(Date, dtCompletionDate, CompletionDate,
                    "When the work was completed; written as a day, left out when it is the zero date.");
    VARNEX_PROPERTY(Text, sDescription, Description, "What was done; written as it is when not empty.");
    VARNEX_RECORD_END;
};

} // namespace varnex3
