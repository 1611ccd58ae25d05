// The messages that can be read come back to the same text: generated ones, and every deliberate loss by itself.
#include "tests/RoundTrip.h"
#include "varnex3/outcomes/Xalo_JobCancelled.h"
#include "varnex3/outcomes/Xalo_PaymentAuthorised.h"
#include "varnex3/outcomes/Xalo_PaymentDeclined.h"

using namespace varnex3;
using tests::CheckElements;
using tests::CheckRoundTrips;
using tests::RaisedBy;
using tests::RecordGenerator;
using tests::SomeOf;
using tests::Trip;

namespace {

// What every message must have to be read at all: the insurer's group is written with an underwriter only.
template <class Message>
void GiveInsurer(const Message& message)
{
    if (!IsSet(message.InsurerField()->UnderwriterName()))
        message.InsurerField()->UnderwriterName(u"Insurer");
}

template <class Message>
Ref<Message> Generated(unsigned seed)
{
    RecordGenerator generator(seed);
    generator.Let("PaymentDetailsDef.PaymentDetailsType", [](RecordGenerator&) { return Variant(std::int32_t{1}); });
    generator.Let("PaymentDetailsDef.TaxInvoiceDate", [](RecordGenerator&) { return Variant(Date()); });
    const auto message = New<Message>();
    generator.Fill(*message);
    GiveInsurer(*message);
    return message;
}

// Of the smallest message that can be read, after a change.
template <class Message, class Change>
Trip TripOf(Change change)
{
    const auto message = New<Message>();
    GiveInsurer(*message);
    change(*message);
    return tests::TripOf(*message);
}

template <class Message, class Change>
bool IsNotWritten(Change change)
{
    return TripOf<Message>(change).first == TripOf<Message>([](Message&) {}).first;
}

} // namespace

TEST_CASE("Authority: ten thousand generated ones are read and written again as the same text")
{
    CheckRoundTrips(Generated<Xalo_PaymentAuthorised>);
}

TEST_CASE("Refusal of payment: ten thousand generated ones are read and written again as the same text")
{
    CheckRoundTrips(Generated<Xalo_PaymentDeclined>);
}

TEST_CASE("Cancellation: ten thousand generated ones are read and written again as the same text")
{
    CheckRoundTrips(Generated<Xalo_JobCancelled>);
}

TEST_CASE("Generator: among the generated messages every optional group and line comes up")
{
    CheckElements(SomeOf(Generated<Xalo_PaymentAuthorised>),
                  {"ClaimHeader", "VehicleID", "Vehicle", "BodyStyle", "PayAuthorityDetails", "RepairerTaxInvoiceNo",
                   "PayAuthorisedDate", "PaymentAmount"});
    CheckElements(SomeOf(Generated<Xalo_PaymentDeclined>),
                  {"ClaimHeader", "QuoteNo", "Vehicle", "LastInvoiceDetails", "ExpectedPaymentDetails",
                   "TotalExcludingTax", "OwnersContributionToCollect", "Reason"});
    CheckElements(SomeOf(Generated<Xalo_JobCancelled>), {"ClaimHeader", "QuoteNo", "Reason"});
}

// ---------------------------------------------------------------- the losses, each by itself

TEST_CASE("Loss: a message without an underwriter is written and cannot be read")
{
    const auto refusalOf = [](auto message) { return RaisedBy([&] { message->ParseXML(message->Serialise()); }); };
    CHECK(refusalOf(New<Xalo_PaymentAuthorised>()) == "91 InsurerDef.ParseXML");
    CHECK(refusalOf(New<Xalo_PaymentDeclined>()) == "91 InsurerDef.ParseXML");
    CHECK(refusalOf(New<Xalo_JobCancelled>()) == "91 InsurerDef.ParseXML");
}

TEST_CASE("Loss: the date of the last invoice is written and not read")
{
    const Trip trip = TripOf<Xalo_PaymentDeclined>([](Xalo_PaymentDeclined& refusal) {
        refusal.LastInvoiceDetailsField()->RepairerTaxInvoiceNo(u"7");
        refusal.LastInvoiceDetailsField()->TaxInvoiceDate(Date{38153});
    });
    CHECK(trip.Loses(u"<TaxInvoiceDate>2004-06-15</TaxInvoiceDate>"));
    CHECK(trip.Keeps(u"<RepairerTaxInvoiceNo>7</RepairerTaxInvoiceNo>"));
}

TEST_CASE("Loss: a last invoice of the other type is written under the other name, and not read")
{
    const Trip trip = TripOf<Xalo_PaymentDeclined>([](Xalo_PaymentDeclined& refusal) {
        refusal.LastInvoiceDetailsField()->RepairerTaxInvoiceNo(u"7");
        refusal.LastInvoiceDetailsField()->PaymentDetailsType(PaymentDetailsTypeEnum::PaymentDetails);
    });
    CHECK(trip.Loses(u"<PaymentDetails>"));
}

TEST_CASE("Loss: figures of an invoice without a number, and what causes no group, are not written")
{
    CHECK(IsNotWritten<Xalo_PaymentDeclined>(
        [](Xalo_PaymentDeclined& refusal) { refusal.LastInvoiceDetailsField()->TotalPayableAmount(100); }));
    CHECK(IsNotWritten<Xalo_PaymentDeclined>([](Xalo_PaymentDeclined& refusal) {
        const auto& contribution = refusal.ExpectedPaymentDetailsField()->OwnersContributionToCollect();
        contribution->Value(100);
        contribution->Reason(u"rust");
    }));
    CHECK(IsNotWritten<Xalo_JobCancelled>(
        [](Xalo_JobCancelled& cancellation) { cancellation.ClaimHeaderField()->ReinstatementNo(5); }));
}

TEST_CASE("Loss: expected and authorised amounts of 0 or less are not written")
{
    CHECK(IsNotWritten<Xalo_PaymentDeclined>(
        [](Xalo_PaymentDeclined& refusal) { refusal.ExpectedPaymentDetailsField()->TaxRate(-10); }));
    CHECK(IsNotWritten<Xalo_PaymentAuthorised>(
        [](Xalo_PaymentAuthorised& authority) { authority.PayAuthorityDetailsField()->PaymentAmount(-10); }));
}

TEST_CASE("Loss: an amount that rounds to 0.00 is written, read as 0, and written no more")
{
    CHECK(TripOf<Xalo_PaymentDeclined>([](Xalo_PaymentDeclined& refusal) {
              refusal.ExpectedPaymentDetailsField()->TaxRate(0.004);
          }).Loses(u"<TaxRate>0.00</TaxRate>"));
    CHECK(TripOf<Xalo_PaymentAuthorised>([](Xalo_PaymentAuthorised& authority) {
              authority.PayAuthorityDetailsField()->PaymentAmount(0.004);
          }).Loses(u"<PaymentAmount>0.00</PaymentAmount>"));
}

TEST_CASE("Loss: the time of day of the authority, and what of an amount is beyond two decimals")
{
    const auto details = New<PayAuthorityDetailsDef>();
    details->PayAuthorisedDate(Date{39636.75});
    details->PaymentAmount(9.999);
    const auto again = New<PayAuthorityDetailsDef>();
    again->ParseXML(details->Serialise());
    CHECK(again->PayAuthorisedDate() == Date{39636});
    CHECK(again->PaymentAmount() == 10);
}

TEST_CASE("Loss: a date whose day is the zero date's is written, read as the zero date, and written no more")
{
    const Trip trip = TripOf<Xalo_PaymentAuthorised>(
        [](Xalo_PaymentAuthorised& authority) { authority.PayAuthorityDetailsField()->PayAuthorisedDate(Date{0.25}); });
    CHECK(trip.Loses(u"<PayAuthorisedDate>1899-12-30</PayAuthorisedDate>"));
}

TEST_CASE("Loss: a further field of the insurer without a value is not written; the repairer's is, and comes back")
{
    CHECK(IsNotWritten<Xalo_JobCancelled>(
        [](Xalo_JobCancelled& cancellation) { cancellation.InsurerField()->InsurerDetail()->Add(u"Fax", u""); }));
    CHECK(TripOf<Xalo_JobCancelled>([](Xalo_JobCancelled& cancellation) {
              cancellation.RepairerField()->RepairerDetails()->Add(u"Fax", u"");
          }).Keeps(u"<RepairerDetails FieldName=\"Fax\"></RepairerDetails>"));
}

TEST_CASE("Loss: no text is escaped, so that one with markup cannot be read")
{
    const auto cancellation = New<Xalo_JobCancelled>();
    GiveInsurer(*cancellation);
    cancellation->RepairerField()->RepairerName(u"Brown & Sons");
    CHECK(RaisedBy([&] { cancellation->ParseXML(cancellation->Serialise()); }) == "91 SourceDef.ParseXML");
    cancellation->RepairerField()->RepairerName(u"");
    cancellation->ReasonField(u"a < b");
    CHECK(RaisedBy([&] { cancellation->ParseXML(cancellation->Serialise()); }) == "91 SourceDef.ParseXML");
}

TEST_CASE("Loss: a text of white space alone is read as empty; line ends in a text become LF")
{
    const Trip blank = TripOf<Xalo_JobCancelled>([](Xalo_JobCancelled& message) { message.ReasonField(u" \t "); });
    CHECK(blank.Loses(u"<Reason> \t </Reason>"));
    const Trip lines =
        TripOf<Xalo_JobCancelled>([](Xalo_JobCancelled& message) { message.ReasonField(u"a\r\nb\rc\nd"); });
    CHECK(lines.Loses(u"<Reason>a\r\nb\rc\nd</Reason>"));
    CHECK(lines.second.find(u"<Reason>a\nb\nc\nd</Reason>") != Text::npos);
}
