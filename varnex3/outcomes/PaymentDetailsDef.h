// The figures of an invoice, as the invoice has them and as the answer that declines it repeats them.
#pragma once

#include "varnex3/core/Rows.h"
#include "varnex3/quote/OwnersContributionToCollectDef.h"

namespace varnex3 {

VARNEX_ENUM(PaymentDetailsTypeEnum, "Which invoice payment details are of.",
            (PaymentDetails, 0, "The invoice of the message; written as PaymentDetails."),
            (LastInvoiceDetails, 1, "The last invoice; written as LastInvoiceDetails."));

class PaymentDetailsDef final : public Record
{
    VARNEX_RECORD(PaymentDetailsDef, "The figures of an invoice, in an element named by the type.");
    VARNEX_ACCESSORS(PaymentDetailsTypeEnum, PaymentDetailsType,
                     "Which invoice the figures are of, and so the name of the element that is written and read. A "
                     "number outside the enumeration is stored, but the element keeps the name it had.");
    VARNEX_SERIALISE("The type's element with every amount, those of 0 too; nothing without RepairerTaxInvoiceNo.");
    VARNEX_PARSEXML(Variant, "Reads the type's element; absent values are 0 or empty. TaxInvoiceDate is not read and "
                             "stays as it was. An amount that is no number raises TypeMismatch (13).");
    VARNEX_PROPERTY(Text, sRepairerTaxInvoiceNo, RepairerTaxInvoiceNo,
                    "The repairer's number of the invoice; nothing is written without it.");
    VARNEX_PROPERTY(Date, dtTaxInvoiceDate, TaxInvoiceDate,
                    "Date of the invoice; written as a day, left out when it is the zero date, never read.");
    VARNEX_PROPERTY(double, dTotalExcludingTax, TotalExcludingTax, "Total without tax, in dollars.");
    VARNEX_PROPERTY(double, dTotalTaxAmount, TotalTaxAmount, "Tax on the total, in dollars.");
    VARNEX_PROPERTY(double, dTotalIncludingTax, TotalIncludingTax, "Total with tax, in dollars.");
    VARNEX_PROPERTY(double, dExcessToCollect, ExcessToCollect, "Excess to collect from the owner, in dollars.");
    VARNEX_PROPERTY(Child<OwnersContributionToCollectDef>, objOwnersContributionToCollect, OwnersContributionToCollect,
                    "What the owner is to pay.");
    VARNEX_PROPERTY(double, dTotalPayableAmount, TotalPayableAmount, "What is to be paid, in dollars.");
    VARNEX_PROPERTY(double, dTaxRate, TaxRate, "Rate of the tax, in per cent.");

public:
    PaymentDetailsDef();

    // The element of a type, and where its values are read.
    struct Element
    {
        Name name;
        ElementPath repairerTaxInvoiceNo;
        ElementPath totalExcludingTax;
        ElementPath totalTaxAmount;
        ElementPath totalIncludingTax;
        ElementPath excessToCollect;
        ElementPath ownersContributionToCollect;
        ElementPath totalPayableAmount;
        ElementPath taxRate;
    };

private:
    const Element* element;
    PaymentDetailsTypeEnum ePaymentDetailsType = PaymentDetailsTypeEnum::PaymentDetails;
    VARNEX_RECORD_END;
};

// A new record of the last invoice's figures.
Ref<PaymentDetailsDef> NewLastInvoiceDetails();

} // namespace varnex3
