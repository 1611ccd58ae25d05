// Error details and reference data as lists: how much they hold, and what they are as JSON.
#include <string>

#include "tests/Printing.h"
#include "varnex3/core/Json.h"
#include "varnex3/notices/ErrorDetailsDef.h"
#include "varnex3/notices/ReferenceDataDef.h"

using namespace varnex3;
using tests::RaisedBy;

namespace {

Text Repeated(TextView element, int count)
{
    Text text;
    for (int i = 0; i < count; ++i)
        text += element;
    return text;
}

} // namespace

TEST_CASE("ErrorDetails: 40,000 items are counted; a 16-bit position reaches 32,768 of them")
{
    const auto details = New<ErrorDetailsDef>();
    for (int i = 0; i < 40000; ++i)
        details->Add();
    details->ErrorItems(32767)->MessageTypeError()->Description(u"the last within reach");
    CHECK(details->Count() == 40000);
    CHECK(details->ErrorItemsDescCSV() == u"the last within reach");
}

TEST_CASE("ReferenceData: a list longer than its count can say is read and written whole")
{
    const Text values = Repeated(u"<DataValue><Code>c</Code></DataValue>", 40000);
    const auto data = New<ReferenceDataDef>();
    data->ParseXML(u"<ReferenceData><DataType Name=\"long\">" + values + u"</DataType></ReferenceData>");
    const auto type = data->Items(0);
    CHECK(RaisedBy([&] { type->Count(); }) == "6 ReferenceDataDefDataType.Count");
    CHECK(type->Items(32767)->Code() == u"c");
    const auto again = New<ReferenceDataDef>();
    again->ParseXML(data->Serialise());
    CHECK(again->Serialise() == data->Serialise());
    CHECK(data->Serialise().size() > 40000 * 70);
}

TEST_CASE("XaloErrorType: the kinds are 1 to 4, and 0 is none of them")
{
    CHECK(XaloErrorTypeInfo.values.size() == 4);
    CHECK(XaloErrorTypeInfo.values.front().value == 1);
    CHECK(XaloErrorTypeInfo.values.back().value == 4);
    CHECK(static_cast<int>(New<ErrorDetailsItem>()->ErrorType()) == 0);
}

TEST_CASE("ErrorDetails: as JSON a list is the array of its items; a type has its name, none is 0")
{
    const auto details = New<ErrorDetailsDef>();
    details->Add();
    details->ParseXML(u"<ErrorDetails><MessageOrderError/></ErrorDetails>");
    const std::string json = ToJson(*details);
    CHECK(json.starts_with("{\"ErrorItems\":[{\"SeverityDescription\":\"\",\"ErrorType\":0,"));
    CHECK(json.find("\"ErrorType\":\"Xalo_MessageOrderError\"") != std::string::npos);
    CHECK(json.ends_with("\"Count\":2}"));
}

TEST_CASE("ReferenceData: as JSON the data types are an array, and so are the values of each")
{
    const auto data = New<ReferenceDataDef>();
    data->ParseXML(u"<ReferenceData><DataType Name=\"A\"><DataValue><Code>X</Code></DataValue></DataType>"
                   u"</ReferenceData>");
    CHECK(ToJson(*data)
          == "{\"Items\":[{\"Items\":[{\"Code\":\"X\",\"Description\":\"\"}],\"Count\":1,\"NameAttribute\":\"A\"}],"
             "\"Count\":1}");
}
