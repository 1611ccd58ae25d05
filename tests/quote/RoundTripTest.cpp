// What is written reads back to the same text: generated messages, and every deliberate loss by itself.
#include "tests/RoundTrip.h"
#include "varnex3/quote/Xalo_Quote.h"
#include "varnex3/request/Xalo_RequestForQuote.h"

using namespace varnex3;
using tests::CheckElements;
using tests::CheckRoundTrips;
using tests::RaisedBy;
using tests::RecordGenerator;
using tests::SomeOf;
using tests::Trip;

namespace {

// What every message must have to be read at all.
template <class Message>
void GiveParties(Message& message)
{
    if (!IsSet(message.InsurerField()->UnderwriterName()))
        message.InsurerField()->UnderwriterName(u"Insurer");
    if (!IsSet(message.RepairerField()->RepairerID()))
        message.RepairerField()->RepairerID(u"1");
}

// What an item of a part must have so that it is written, and comes back as what it is.
void GivePart(const QuoteItem& item)
{
    const auto& part = item.Part();
    if (part->PartQuantity() <= 0)
        part->PartQuantity(1);
    if (!IsSet(part->PartSource()->PartNumber()))
        part->PartSource()->PartNumber(u"1");
}

void MakeReadable(Xalo_Quote& quote)
{
    GiveParties(quote);
    if (!IsSet(quote.QuoteDateField()))
        quote.QuoteDateField(Date{38061});
    quote.InspectionReqestedField()->InspectionReason(u"");
    const auto count = static_cast<std::int16_t>(quote.QuoteItemsField()->Count());
    for (std::int16_t i = 0; i < count; ++i)
        GivePart(*quote.QuoteItemsField()->QuoteItems(i));
}

void MakeReadable(Xalo_RequestForQuote& request)
{
    GiveParties(request);
    const auto& details = request.RequestDetailsField();
    if (!IsSet(details->RequestDate()))
        details->RequestDate(Date{38061});
    if (!IsSet(details->EstimatedQuoteDate()))
        details->EstimatedQuoteDate(Date{38065});
}

RecordGenerator GeneratorFor(unsigned seed)
{
    RecordGenerator generator(seed);
    const auto anyText = [](RecordGenerator& any) { return Variant(any.AnyText()); };
    for (const char* const escaped : {"RepairerDef.RepairerName", "CustomerDef.CompanyName", "PersonalNameDef.Title",
                                      "VehicleDetailsDef.Colour", "QuoteDetailsDef.OpenText"})
        generator.Let(escaped, anyText);
    generator.Let("VehicleDetailsDefOdometer.OdometerReading",
                  [](RecordGenerator& any) { return Variant(any.NumberText()); });
    generator.Let("QuoteItemPartPartSource.PartSourceCode", [](RecordGenerator& any) { // the others are all OEM
        return Variant(Text(1, u"AXCUR "[any.Between(0, 5)]));
    });
    generator.Let("QuoteHoursDef.Category", [](RecordGenerator& any) { return Variant(any.Between(0, 2)); });
    return generator;
}

template <class Message>
Ref<Message> Generated(unsigned seed)
{
    const auto message = New<Message>();
    GeneratorFor(seed).Fill(*message);
    MakeReadable(*message);
    return message;
}

// A quote that can be read, with nothing else in it.
Ref<Xalo_Quote> SmallestQuote()
{
    const auto quote = New<Xalo_Quote>();
    MakeReadable(*quote);
    return quote;
}

// Of the smallest quote after a change.
template <class Change>
Trip TripOf(Change change)
{
    const auto quote = SmallestQuote();
    change(*quote);
    return tests::TripOf(*quote);
}

template <class Change>
Trip TripOfItem(Change change)
{
    return TripOf([&](Xalo_Quote& quote) { change(*quote.QuoteItemsField()->Add()); });
}

} // namespace

TEST_CASE("Quote: ten thousand generated quotes are read and written again as the same text")
{
    CheckRoundTrips(Generated<Xalo_Quote>);
}

TEST_CASE("Request: ten thousand generated requests are read and written again as the same text")
{
    CheckRoundTrips(Generated<Xalo_RequestForQuote>);
}

TEST_CASE("Generator: among the generated quotes every kind of item and every optional line comes up")
{
    const Text all = SomeOf(Generated<Xalo_Quote>);
    CheckElements(all, {"QuoteNo",
                        "QuoteDate",
                        "VarnexStatus",
                        "QuoteDetails",
                        "OwnersContributionToCollect",
                        "OpenText",
                        "Vehicle",
                        "VehicleDetails",
                        "Odometer",
                        "EngineSize",
                        "HourlyRates",
                        "Defines",
                        "QuoteItems",
                        "RemoveReplace",
                        "Repair",
                        "PaintLabour",
                        "OtherPaintGroup",
                        "PaintMaterials",
                        "Part",
                        "Aftermarket",
                        "Exchange",
                        "Used",
                        "Miscellaneous",
                        "Sublet",
                        "Mechanical",
                        "Towing",
                        "Comment",
                        "UpdateStatus",
                        "Assessment",
                        "Customer",
                        "PersonalName"});
    CHECK(all.find(u"<OEM PartNumber=") != Text::npos);
    CHECK(all.find(u"<ReportOn/>") != Text::npos);
}

// ---------------------------------------------------------------- the losses, each by itself

TEST_CASE("Loss: the inspection is written and not read")
{
    const Trip trip = TripOf([](Xalo_Quote& quote) { quote.InspectionReqestedField()->InspectionReason(u"rust"); });
    CHECK(trip.Loses(u"InspectionReqested"));
}

TEST_CASE("Loss: a quote without a date, an underwriter or a repairer is written and cannot be read")
{
    const auto quote = SmallestQuote();
    quote->QuoteDateField(Date());
    CHECK(RaisedBy([&] { New<Xalo_Quote>()->ParseXML(quote->Serialise()); }) == "13 Xalo_Quote.ParseXML");
    quote->RepairerField()->RepairerID(u"");
    CHECK(RaisedBy([&] { New<Xalo_Quote>()->ParseXML(quote->Serialise()); }) == "91 RepairerDef.ParseXML");
    quote->InsurerField()->UnderwriterName(u"");
    CHECK(RaisedBy([&] { New<Xalo_Quote>()->ParseXML(quote->Serialise()); }) == "91 InsurerDef.ParseXML");
}

TEST_CASE("Loss: a rate that rounds to 0.00 is written, read as 0, and written no more")
{
    const Trip trip = TripOfItem([](QuoteItem& item) { item.RemoveReplace()->HourlyRate(0.004); });
    CHECK(trip.Loses(u"<HourlyRate>0.00</HourlyRate>"));
}

TEST_CASE("Loss: a part whose value rounds to 0.00 comes back as an item of removing and replacing")
{
    const Trip trip = TripOfItem([](QuoteItem& item) {
        item.QuoteItemType(QuoteItemTypeEnum::QuoteItemPart);
        item.Part()->PartValue(0.004);
    });
    CHECK(trip.Loses(u"<PartSource>"));
    CHECK(trip.Keeps(u"<PartValue>0.00</PartValue>") == false);
}

TEST_CASE("Loss: an item whose kind writes nothing comes back as one of removing and replacing")
{
    const auto becomesRemoveReplace = [](const Trip& trip) {
        return trip.first.find(u"<RemoveReplace>") == Text::npos && trip.second.find(u"<RemoveReplace>") != Text::npos;
    };
    CHECK(becomesRemoveReplace(TripOfItem([](QuoteItem& item) { item.QuoteItemType(QuoteItemTypeEnum{8}); })));
    CHECK(becomesRemoveReplace(
        TripOfItem([](QuoteItem& item) { item.QuoteItemType(QuoteItemTypeEnum::QuoteItemPart); })));
    CHECK(becomesRemoveReplace(TripOfItem([](QuoteItem& item) {
        item.QuoteItemType(QuoteItemTypeEnum::QuoteItemRepair);
        item.Repair()->Category(QuoteHoursTypeEnum::None);
    })));
}

TEST_CASE("Loss: the part number of a source other than OEM is not written")
{
    const auto item = New<QuoteItem>();
    item->QuoteItemType(QuoteItemTypeEnum::QuoteItemPart);
    item->Part()->PartQuantity(1);
    item->Part()->PartSource()->PartNumber(u"123");
    const auto again = New<QuoteItem>();
    again->ParseXML(item->Serialise());
    CHECK(again->Part()->PartSource()->PartNumber() == u"");
}

TEST_CASE("Loss: a paint rate without a group, and a group without a rate, are not written")
{
    const auto labour = New<QuoteItemPaintLabour>();
    labour->HourlyRate(60);
    const auto again = New<QuoteItemPaintLabour>();
    again->ParseXML(labour->Serialise());
    CHECK(again->HourlyRate() == 0);
    labour->HourlyRate(0);
    labour->OtherPaintGroup(u"Pearl");
    again->ParseXML(labour->Serialise());
    CHECK(again->OtherPaintGroup() == u"");
}

TEST_CASE("Loss: a sublet type of blanks alone is written empty, and the sublet no more")
{
    const Trip trip = TripOfItem([](QuoteItem& item) {
        item.QuoteItemType(QuoteItemTypeEnum::QuoteItemMiscellaneous);
        item.Miscellaneous()->Sublet()->SubletType(u"  ");
    });
    CHECK(trip.Loses(u"<SubletType></SubletType>"));
}

TEST_CASE("Loss: a text of white space alone reads as the empty text, and is written no more")
{
    const Trip trip = TripOfItem([](QuoteItem& item) { item.Code(u" \t "); });
    CHECK(trip.Loses(u"<Code> \t </Code>"));
}

TEST_CASE("Loss: line ends in a text become LF")
{
    const Trip trip = TripOfItem([](QuoteItem& item) { item.Comment(u"a\r\nb\rc\nd"); });
    CHECK(trip.Loses(u"<Comment>a\r\nb\rc\nd</Comment>"));
    CHECK(trip.second.find(u"<Comment>a\nb\nc\nd</Comment>") != Text::npos);
}

TEST_CASE("Loss: white space in a part number, an attribute, becomes blanks")
{
    const Trip trip = TripOfItem([](QuoteItem& item) {
        item.QuoteItemType(QuoteItemTypeEnum::QuoteItemPart);
        item.Part()->PartQuantity(1);
        item.Part()->PartSource()->Category(PartSourceTypeEnum::OEM);
        item.Part()->PartSource()->PartNumber(u"1\t2\n3");
    });
    CHECK(trip.second.find(u"<OEM PartNumber=\"1 2 3\">") != Text::npos);
}

TEST_CASE("Loss: an entity in a text that is not escaped is read as its character, and then no more well-formed")
{
    const Trip trip = TripOfItem([](QuoteItem& item) { item.Comment(u"a &amp; b"); });
    CHECK(trip.Loses(u"<Comment>a &amp; b</Comment>"));
    CHECK(trip.second.find(u"<Comment>a & b</Comment>") != Text::npos);
    CHECK(RaisedBy([&] { New<Xalo_Quote>()->ParseXML(trip.second); }) == "91 SourceDef.ParseXML");
}

TEST_CASE("Loss: a date whose day is the zero date's is written, read as the zero date, and written no more")
{
    const Trip trip = TripOf([](Xalo_Quote& quote) { quote.AssessmentField()->AssessmentDate(Date{0.25}); });
    CHECK(trip.Loses(u"<AssessmentDate>1899-12-30</AssessmentDate>"));
}

TEST_CASE("Loss: the time of day of a date, and what of an amount is beyond two decimals")
{
    const auto quote = SmallestQuote();
    quote->QuoteDateField(Date{38061.75});
    quote->TotalsField()->TaxRate(9.999);
    const auto again = New<Xalo_Quote>();
    again->ParseXML(quote->Serialise());
    CHECK(again->QuoteDateField() == Date{38061});
    CHECK(again->TotalsField()->TaxRate() == 10);
}

TEST_CASE("Loss: values that do not cause their element are not written by themselves")
{
    const auto same = [](const auto& change) {
        const Trip trip = TripOf(change);
        return trip.first == SmallestQuote()->Serialise();
    };
    CHECK(same([](Xalo_Quote& quote) { quote.VehicleDetailsField()->EngineSize(2); }));
    CHECK(same([](Xalo_Quote& quote) { quote.VehicleDetailsField()->Odometer()->OdometerReading(u"5"); }));
    CHECK(same([](Xalo_Quote& quote) { quote.ClaimHeaderField()->ReinstatementNo(5); }));
    CHECK(same([](Xalo_Quote& quote) { quote.CustomerField()->CustomerType(CustomerTypeEnum::Company); }));
    CHECK(same([](Xalo_Quote& quote) {
        quote.QuoteDetailsField()->OwnersContributionToCollect()->Reason(u"rust");
        quote.QuoteDetailsField()->OwnersContributionToCollect()->Value(1);
    }));
}
