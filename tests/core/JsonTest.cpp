#include "varnex3/core/Json.h"

#include <fstream>
#include <iterator>
#include <nlohmann/json.hpp>

#include "tests/Printing.h"
#include "varnex3/varnex3.h"

using namespace varnex3;

namespace {

Text MessageText(const std::string& name)
{
    std::ifstream file(VARNEX3_SOURCE_DIR "/tests/messages/" + name, std::ios::binary);
    return ToUtf16(std::string(std::istreambuf_iterator<char>(file), {}));
}

template <class T>
std::string JsonOf(const Ref<T>& record)
{
    return ToJson(*record);
}

} // namespace

TEST_CASE("ToJson: the properties in interface order, on one line")
{
    const auto claim = New<ClaimHeaderDef>();
    CHECK(JsonOf(claim) == R"({"VehicleID":"","InsuranceClaimNo":"","ReinstatementNo":0})");
    claim->ParseXML(MessageText("ClaimHeaderDef-full.xml"));
    CHECK(JsonOf(claim) == R"({"VehicleID":"V-17","InsuranceClaimNo":"C2004/315","ReinstatementNo":3})");
}

TEST_CASE("ToJson: dates are yyyy-mm-ddThh:mm:ss, the zero date too")
{
    const auto source = New<SourceDef>();
    CHECK(JsonOf(source) == R"({"OrgType":"","AppVersion":"","AppName":"","TimeStamp":"1899-12-30T00:00:00"})");
    source->ParseXML(MessageText("SourceDef-full.xml"));
    CHECK(JsonOf(source)
          == R"({"OrgType":"REP","AppVersion":"8.12","AppName":"Workshop","TimeStamp":"2004-03-15T14:05:09"})");
}

TEST_CASE("ToJson: children are objects, enumerations the name of their constant")
{
    const auto customer = New<CustomerDef>();
    customer->ParseXML(MessageText("CustomerDef-full.xml"));
    customer->CustomerType(CustomerTypeEnum::Company);
    CHECK(JsonOf(customer)
          == R"({"CompanyName":"Grace & Co","BusinessPhone":"03 9555 0101","Fax":"03 9555 0102",)"
             R"("MobilePhone":"0400 555 103","CustomerType":"Company","PersonalName":{"FullName":"Grace Hopper",)"
             R"("Forname":"Grace","Title":"Ms","Surname":"Hopper","HomePhone":"03 9555 0104"}})");
}

TEST_CASE("ToJson: an enumeration's number without a constant is the number")
{
    const auto customer = New<CustomerDef>();
    customer->CustomerType(static_cast<CustomerTypeEnum>(17));
    CHECK(nlohmann::json::parse(JsonOf(customer))["CustomerType"] == 17);
}

TEST_CASE("ToJson: an indexed property is an array of its items, and reading it adds none")
{
    const auto details = New<InsurerDetailDef>();
    CHECK(JsonOf(details) == R"({"Values":[],"Fields":[],"Count":0})");
    details->Add(u"Phone", u"1");
    details->Add(u"7", u"");
    CHECK(JsonOf(details) == R"({"Values":["1",""],"Fields":["Phone","7"],"Count":2})");
    CHECK(details->Count() == 2);
}

TEST_CASE("ToJson: a class without properties is an empty object") { CHECK(JsonOf(New<XaloBase>()) == "{}"); }

TEST_CASE("ToJson: quotes, backslashes and control characters are escaped, other characters are UTF-8")
{
    const auto destination = New<DestinationDef>();
    destination->OrgType(Text(u"\"\\\r\n\t\0\x1F/é€\U0001F600", 12));
    CHECK(JsonOf(destination) == "{\"OrgType\":\"\\\"\\\\\\r\\n\\t\\u0000\\u001f/é€\xF0\x9F\x98\x80\"}");
}

TEST_CASE("ToJson: a lone surrogate becomes U+FFFD")
{
    const auto destination = New<DestinationDef>();
    destination->OrgType(u"\xDC00\xD800\xD800\xDC00\xD800");
    CHECK(JsonOf(destination) == "{\"OrgType\":\"��\xF0\x90\x80\x80�\"}");
}

TEST_CASE("ToJson: a message's summary, type by name and flags as Booleans")
{
    const auto message = New<MessageDef>();
    message->ParseXML(MessageText("MessageDef-quote.xml"), u"q.xml", Text(u"/inbox/q.xml"));
    auto json = nlohmann::ordered_json::parse(JsonOf(message));
    CHECK(ToUtf16(json["SourceXML"].get<std::string>()) == message->SourceXML());
    json.erase("SourceXML");
    CHECK(json.dump()
          == R"({"ImageNo":"I5","RepairerID":"R100","FileName":"q.xml","FilePath":"/inbox/q.xml",)"
             R"("MessageType":"Xalo_Quote","MessageTypeID":"Xalo_Quote","MessageDescription":"Quote","QuoteNo":"Q77",)"
             R"("MessageNo":"M1","Registration":"ABC123","ClaimNo":"C2004","Customer":"Grace Hopper",)"
             R"("VehicleDesciption":"Corvino Astrid","VehicleID":"V-17","ParseError":false,"ErrorMessage":"",)"
             R"("VarnexStatusCode":"QR","VarnexStatusDescription":""})");
}

TEST_CASE("ToJson: a folder's messages are an array")
{
    const auto messages = New<Xalo_Messages>();
    messages->Add(u"a")->MessageNo(u"1");
    messages->Add(u"b")->MessageNo(u"2");
    const auto json = nlohmann::json::parse(JsonOf(messages));
    CHECK(json["Count"] == 2);
    CHECK(json["MessageItems"].size() == 2);
    CHECK(json["MessageItems"][1]["MessageNo"] == "2");
}

TEST_CASE("ToJson: every class of the library gives JSON of all its plain properties")
{
    for (const ClassInfo* const info : Classes()) {
        if (info->IsModule())
            continue;
        CAPTURE(std::string(info->name));
        const auto json = nlohmann::json::parse(JsonOf(info->create()));
        for (const Member& member : info->members)
            if (member.IsProperty() && !member.IsIndexed())
                CHECK(json.contains(std::string(member.name)));
    }
}
