#include "varnex3/outcomes/PaymentDetailsDef.h"

namespace varnex3 {

VARNEX_DEFINE(PaymentDetailsDef);

namespace {

using Element = PaymentDetailsDef::Element;

constexpr Element kPaymentDetails{"PaymentDetails",
                                  "PaymentDetails/RepairerTaxInvoiceNo",
                                  "PaymentDetails/TotalExcludingTax",
                                  "PaymentDetails/TotalTaxAmount",
                                  "PaymentDetails/TotalIncludingTax",
                                  "PaymentDetails/ExcessToCollect",
                                  "PaymentDetails/OwnersContributionToCollect",
                                  "PaymentDetails/TotalPayableAmount",
                                  "PaymentDetails/TaxRate"};

constexpr Element kLastInvoiceDetails{"LastInvoiceDetails",
                                      "LastInvoiceDetails/RepairerTaxInvoiceNo",
                                      "LastInvoiceDetails/TotalExcludingTax",
                                      "LastInvoiceDetails/TotalTaxAmount",
                                      "LastInvoiceDetails/TotalIncludingTax",
                                      "LastInvoiceDetails/ExcessToCollect",
                                      "LastInvoiceDetails/OwnersContributionToCollect",
                                      "LastInvoiceDetails/TotalPayableAmount",
                                      "LastInvoiceDetails/TaxRate"};

} // namespace

PaymentDetailsDef::PaymentDetailsDef() : element(&kPaymentDetails) {}

PaymentDetailsTypeEnum PaymentDetailsDef::PaymentDetailsType() { return ePaymentDetailsType; }

void PaymentDetailsDef::PaymentDetailsType(PaymentDetailsTypeEnum value)
{
    ePaymentDetailsType = value;
    if (value == PaymentDetailsTypeEnum::PaymentDetails)
        element = &kPaymentDetails;
    else if (value == PaymentDetailsTypeEnum::LastInvoiceDetails)
        element = &kLastInvoiceDetails; // with any other number the element keeps its name
}

void PaymentDetailsDef::Write(XmlWriter& xml) const
{
    if (!IsSet(sRepairerTaxInvoiceNo))
        return;

    xml.Open(element->name);
    xml.Always("RepairerTaxInvoiceNo", sRepairerTaxInvoiceNo);
    xml.IfSet("TaxInvoiceDate", dtTaxInvoiceDate);
    xml.Always("TotalExcludingTax", dTotalExcludingTax);
    xml.Always("TotalTaxAmount", dTotalTaxAmount);
    xml.Always("TotalIncludingTax", dTotalIncludingTax);
    xml.Always("ExcessToCollect", dExcessToCollect);
    xml.Append(objOwnersContributionToCollect);
    xml.Always("TotalPayableAmount", dTotalPayableAmount);
    xml.Always("TaxRate", dTaxRate);
    xml.Close(element->name);
}

void PaymentDetailsDef::Read(const XmlSection& section)
{
    sRepairerTaxInvoiceNo = section.TextAt(element->repairerTaxInvoiceNo);
    // TaxInvoiceDate, though it is written, is not read
    dTotalExcludingTax = section.NumberAt(element->totalExcludingTax);
    dTotalTaxAmount = section.NumberAt(element->totalTaxAmount);
    dTotalIncludingTax = section.NumberAt(element->totalIncludingTax);
    dExcessToCollect = section.NumberAt(element->excessToCollect);
    section.ReadInto(objOwnersContributionToCollect, element->ownersContributionToCollect);
    dTotalPayableAmount = section.NumberAt(element->totalPayableAmount);
    dTaxRate = section.NumberAt(element->taxRate);
}

Ref<PaymentDetailsDef> NewLastInvoiceDetails()
{
    auto details = New<PaymentDetailsDef>();
    details->PaymentDetailsType(PaymentDetailsTypeEnum::LastInvoiceDetails);
    return details;
}

} // namespace varnex3
