// Amounts and dates that cannot be written, and amounts that are not numbers: what no rule file can hold.
#include <limits>

#include "tests/Printing.h"
#include "varnex3/outcomes/Xalo_AdjustmentNote.h"
#include "varnex3/outcomes/Xalo_Declined.h"
#include "varnex3/outcomes/Xalo_PaymentAuthorised.h"
#include "varnex3/outcomes/Xalo_PaymentDeclined.h"
#include "varnex3/outcomes/Xalo_ReactivateInvoice.h"
#include "varnex3/outcomes/Xalo_TaxInvoice.h"

using namespace varnex3;
using tests::RaisedBy;

namespace {

constexpr double kInfinity = std::numeric_limits<double>::infinity();
constexpr double kNotANumber = std::numeric_limits<double>::quiet_NaN();

template <class Message>
std::string RaisedWhenWritten(const Ref<Message>& message)
{
    return RaisedBy([&] { message->Serialise(); });
}

} // namespace

TEST_CASE("What an amount raises comes through the whole message, in the name of the record that has the amount")
{
    const auto invoice = New<Xalo_TaxInvoice>();
    invoice->PaymentDetailsField()->RepairerTaxInvoiceNo(u"7");
    invoice->PaymentDetailsField()->TaxRate(kNotANumber);
    CHECK(RaisedWhenWritten(invoice) == "6 PaymentDetailsDef.Serialise");
    const auto note = New<Xalo_AdjustmentNote>();
    note->AdjustmentNoteDetailsField()->AdjustmentNote(true);
    note->AdjustmentNoteDetailsField()->SupplyDifferenceAmount(-kInfinity);
    CHECK(RaisedWhenWritten(note) == "6 AdjustmentNoteDetailsDef.Serialise");
    const auto authority = New<Xalo_PaymentAuthorised>();
    authority->PayAuthorityDetailsField()->PaymentAmount(kInfinity);
    CHECK(RaisedWhenWritten(authority) == "6 PayAuthorityDetailsDef.Serialise");
    const auto refusal = New<Xalo_PaymentDeclined>();
    refusal->ExpectedPaymentDetailsField()->TotalTaxAmount(kInfinity);
    CHECK(RaisedWhenWritten(refusal) == "6 ExpectedPaymentDetailsDef.Serialise");
}

TEST_CASE("What a date raises comes through the whole message")
{
    const Date beyond{1e9};
    const auto reactivation = New<Xalo_ReactivateInvoice>();
    reactivation->ReActivateInvoiceDateField(beyond);
    CHECK(RaisedWhenWritten(reactivation) == "6 modFunctions.FormatDate");
    const auto refusal = New<Xalo_Declined>();
    refusal->DeclinedDetailField()->DeclinedDate(beyond);
    CHECK(RaisedWhenWritten(refusal) == "none"); // without a reason it is not written
    refusal->DeclinedDetailField()->ReasonText(u"full");
    CHECK(RaisedWhenWritten(refusal) == "6 modFunctions.FormatDate");
}

TEST_CASE("Not-a-number is not greater than 0: where amounts are written only then it is left out, and causes nothing")
{
    const auto expected = New<ExpectedPaymentDetailsDef>();
    expected->TotalExcludingTax(kNotANumber);
    CHECK(expected->Serialise() == u"");
    expected->TaxRate(10);
    CHECK(expected->Serialise()
          == u"\t<ExpectedPaymentDetails>\r\n\t\t<TaxRate>10.00</TaxRate>\r\n\t</ExpectedPaymentDetails>\r\n");
    const auto authority = New<PayAuthorityDetailsDef>();
    authority->PaymentAmount(kNotANumber);
    CHECK(authority->Serialise() == u"");
}
