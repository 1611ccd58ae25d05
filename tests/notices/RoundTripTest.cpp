// The messages that can be read come back to the same text: generated ones, and every deliberate loss by itself.
#include "tests/RoundTrip.h"
#include "varnex3/notices/Xalo_Error.h"
#include "varnex3/notices/Xalo_VarnexReferenceData.h"
#include "varnex3/notices/Xalo_VarnexVersionChange.h"

using namespace varnex3;
using tests::CheckElements;
using tests::CheckRoundTrips;
using tests::RaisedBy;
using tests::RecordGenerator;
using tests::SomeOf;
using tests::Trip;

namespace {

// The numbers of an order error come back where both are greater than 0, or neither is.
void GiveBothNumbers(ErrorDetailsDefMessageOrderError& order)
{
    if (order.ExpectedMessageNo() > 0 && order.ReceivedMessageNo() <= 0)
        order.ReceivedMessageNo(1);
    if (order.ReceivedMessageNo() > 0 && order.ExpectedMessageNo() <= 0)
        order.ExpectedMessageNo(1);
}

// What a message must have to be read at all, and to come back whole.
void MakeReadable(Xalo_Error& message)
{
    if (!IsSet(message.InsurerField()->UnderwriterName()))
        message.InsurerField()->UnderwriterName(u"Insurer");
    const auto count = static_cast<std::int16_t>(message.ErrorDetailsField()->Count());
    for (std::int16_t i = 0; i < count; ++i)
        GiveBothNumbers(*message.ErrorDetailsField()->ErrorItems(i)->MessageOrderError());
}

void MakeReadable(Xalo_VarnexVersionChange& message)
{
    if (!IsSet(message.RepairerField()->RepairerID()))
        message.RepairerField()->RepairerID(u"1");
}

void MakeReadable(Xalo_VarnexReferenceData& /*message*/) {}

template <class Message>
Ref<Message> Generated(unsigned seed)
{
    RecordGenerator generator(seed);
    generator.Let("RepairerDef.RepairerName", [](RecordGenerator& any) { return Variant(any.AnyText()); });
    const auto message = New<Message>();
    generator.Fill(*message);
    MakeReadable(*message);
    return message;
}

// Of the smallest message that can be read, after a change.
template <class Message, class Change>
Trip TripOf(Change change)
{
    const auto message = New<Message>();
    MakeReadable(*message);
    change(*message);
    return tests::TripOf(*message);
}

template <class Message, class Change>
bool IsNotWritten(Change change)
{
    return TripOf<Message>(change).first == TripOf<Message>([](Message&) {}).first;
}

// What reading the message again raises, after a change.
template <class Message, class Change>
std::string RefusalOf(Change change)
{
    return RaisedBy([&] { TripOf<Message>(change); });
}

template <class Change>
Trip TripOfDetail(Change change)
{
    return TripOf<Xalo_Error>([&](Xalo_Error& message) { change(*message.ErrorDetailsField()->Add()); });
}

template <class Change>
Trip TripOfDataType(Change change)
{
    return TripOf<Xalo_VarnexReferenceData>(
        [&](Xalo_VarnexReferenceData& message) { change(*message.ReferenceDataField()->Add()); });
}

} // namespace

TEST_CASE("Error: ten thousand generated ones are read and written again as the same text")
{
    CheckRoundTrips(Generated<Xalo_Error>);
}

TEST_CASE("Version change: ten thousand generated ones are read and written again as the same text")
{
    CheckRoundTrips(Generated<Xalo_VarnexVersionChange>);
}

TEST_CASE("Reference data: ten thousand generated ones are read and written again as the same text")
{
    CheckRoundTrips(Generated<Xalo_VarnexReferenceData>);
}

TEST_CASE("Generator: among the generated messages every optional group and line comes up")
{
    CheckElements(SomeOf(Generated<Xalo_Error>),
                  {"RelatesToMessageNo", "ClaimHeader", "QuoteNo", "ErrorDetails", "Severity", "DataContentError",
                   "ElementName", "Value", "MessageOrderError", "ExpectedMessageNo", "ReceivedMessageNo",
                   "MessageTypeError", "MiscellaneousError"});
    CheckElements(SomeOf(Generated<Xalo_VarnexVersionChange>),
                  {"Version", "XaloVersion", "VarnexVersion", "NextVarnexVersion"});
    const Text data = SomeOf(Generated<Xalo_VarnexReferenceData>);
    CheckElements(data, {"ReferenceData", "DataValue", "Code", "Description"});
    CHECK(data.find(u"<DataType Name=\"\">") != Text::npos);
    CHECK(data.find(u"<DataType Name=\"Front bumper") != Text::npos);
    CHECK(data.find(u"<Description></Description>") != Text::npos);
}

// ---------------------------------------------------------------- the losses, each by itself

TEST_CASE("Loss: an error without an underwriter, a version change without a repairer are written and cannot be read")
{
    const auto refusalOf = [](auto message) { return RaisedBy([&] { message->ParseXML(message->Serialise()); }); };
    CHECK(refusalOf(New<Xalo_Error>()) == "91 InsurerDef.ParseXML");
    CHECK(refusalOf(New<Xalo_VarnexVersionChange>()) == "91 RepairerDef.ParseXML");
    CHECK(refusalOf(New<Xalo_VarnexReferenceData>()) == "none");
}

TEST_CASE("Loss: of one message number greater than 0 the other one's line is written, read, and written no more")
{
    const Trip expected = TripOfDetail([](ErrorDetailsItem& item) {
        item.MessageOrderError()->Description(u"late");
        item.MessageOrderError()->ExpectedMessageNo(5);
    });
    CHECK(expected.Loses(u"<ReceivedMessageNo>0</ReceivedMessageNo>"));
    CHECK(expected.first.find(u"<ExpectedMessageNo>") == Text::npos);
    CHECK(expected.Keeps(u"<Description>late</Description>"));
    const Trip received = TripOfDetail([](ErrorDetailsItem& item) { item.MessageOrderError()->ReceivedMessageNo(7); });
    CHECK(received.Loses(u"<ExpectedMessageNo>0</ExpectedMessageNo>"));
    CHECK(received.Loses(u"<MessageOrderError>"));
}

TEST_CASE("Loss: message numbers below 1 are not written, nor is a kind without what causes it")
{
    const Trip trip = TripOfDetail([](ErrorDetailsItem& item) {
        item.MessageOrderError()->ExpectedMessageNo(-1);
        item.MessageOrderError()->ReceivedMessageNo(-1);
    });
    CHECK(trip.first.find(u"<MessageOrderError>") == Text::npos);
    CHECK(IsNotWritten<Xalo_Error>([](Xalo_Error& message) { message.ClaimHeaderField()->ReinstatementNo(5); }));
}

TEST_CASE("Loss: the severity in words is not written; the type is not either, but read from what is there")
{
    const auto details = New<ErrorDetailsDef>();
    const auto item = details->Add();
    item->SeverityDescription(u"Warning");
    item->MessageTypeError()->Description(u"x");
    details->ParseXML(details->Serialise());
    CHECK(details->ErrorItems(1)->SeverityDescription() == u"");
    CHECK(details->ErrorItems(0)->ErrorType() == XaloErrorType{});
    CHECK(details->ErrorItems(1)->ErrorType() == XaloErrorType::Xalo_MessageTypeError);
}

TEST_CASE("Loss: a data type's attribute comes back as Name, and further attributes not at all")
{
    const auto type = New<ReferenceDataDefDataType>();
    type->ParseXML(u"<DataType Type=\"A\" Since=\"2004\"/>");
    CHECK(type->Serialise() == u"\t\t<DataType Name=\"A\">\r\n\t\t</DataType>\r\n");
}

TEST_CASE("Loss: no text is escaped, so that one with markup cannot be read")
{
    const auto details = [](Xalo_Error& message) { return message.ErrorDetailsField()->Add(); };
    CHECK(RefusalOf<Xalo_Error>([&](Xalo_Error& message) { details(message)->DataContentError()->Value(u"a & b"); })
          == "91 SourceDef.ParseXML");
    CHECK(RefusalOf<Xalo_Error>([](Xalo_Error& message) { message.RepairerField()->RepairerName(u"A & B"); })
          == "91 SourceDef.ParseXML");
    CHECK(RefusalOf<Xalo_VarnexVersionChange>([](auto& message) { message.VersionField()->VarnexVersion(u"<3"); })
          == "91 SourceDef.ParseXML");
    CHECK(RefusalOf<Xalo_VarnexReferenceData>(
              [](auto& message) { message.ReferenceDataField()->Add()->NameAttribute(u"the \"short\" ones"); })
          == "91 SourceDef.ParseXML");
}

TEST_CASE("Loss: a quotation mark may end a data type's name early, and what follows becomes attributes")
{
    const auto type = New<ReferenceDataDefDataType>();
    type->NameAttribute(u"A\" B=\"C");
    const auto again = New<ReferenceDataDefDataType>();
    again->ParseXML(type->Serialise());
    CHECK(again->NameAttribute() == u"A");
}

TEST_CASE("Loss: a text of white space alone is read as empty; line ends in a text become LF")
{
    const Trip blank = TripOf<Xalo_Error>([](Xalo_Error& message) { message.RelatesToMessageNoField(u" \t "); });
    CHECK(blank.Loses(u"<RelatesToMessageNo> \t </RelatesToMessageNo>"));
    const Trip lines = TripOfDetail([](ErrorDetailsItem& item) { item.Severity(u"a\r\nb\rc\nd"); });
    CHECK(lines.Loses(u"<Severity>a\r\nb\rc\nd</Severity>"));
    CHECK(lines.second.find(u"<Severity>a\nb\nc\nd</Severity>") != Text::npos);
}

TEST_CASE("Loss: white space in a data type's name becomes blanks, as in every attribute; blanks stay")
{
    const Trip trip = TripOfDataType([](ReferenceDataDefDataType& type) { type.NameAttribute(u" a\tb\r\nc\nd "); });
    CHECK(trip.second.find(u"<DataType Name=\" a b c d \">") != Text::npos);
    CHECK(trip.first.find(u"<DataType Name=\" a\tb\r\nc\nd \">") != Text::npos);
}

TEST_CASE("Loss: a further field of the insurer without a value is not written; the repairer's is, and comes back")
{
    CHECK(IsNotWritten<Xalo_Error>(
        [](Xalo_Error& message) { message.InsurerField()->InsurerDetail()->Add(u"Fax", u""); }));
    CHECK(TripOf<Xalo_Error>([](Xalo_Error& message) {
              message.RepairerField()->RepairerDetails()->Add(u"Fax", u"");
          }).Keeps(u"<RepairerDetails FieldName=\"Fax\"></RepairerDetails>"));
}

TEST_CASE("Loss: the zone and the fraction of the time stamp")
{
    const auto message = New<Xalo_VarnexReferenceData>();
    const Text again = message->ParseXML(
        u"<Xalo_VarnexReferenceData><Source><OrgType/><AppVersion/><AppName/><TimeStamp>2004-05-06T09:14:27.5+10:00"
        u"</TimeStamp></Source><Destination><OrgType/></Destination><Repairer><RepairerID/><RepairerName/></Repairer>"
        u"</Xalo_VarnexReferenceData>");
    CHECK(again.find(u"<TimeStamp>2004-05-06T09:14:27</TimeStamp>") != Text::npos);
}
