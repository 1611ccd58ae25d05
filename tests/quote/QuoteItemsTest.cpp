#include "varnex3/quote/QuoteItemsDef.h"

#include <algorithm>
#include <limits>
#include <string>

#include "tests/Printing.h"
#include "varnex3/core/Json.h"

using namespace varnex3;
using tests::RaisedBy;

namespace {

Text Items(int count, TextView inside = u"<ItemNo>1</ItemNo>")
{
    Text text = u"<QuoteItems>";
    for (int i = 0; i < count; ++i)
        text.append(u"<QuoteItem>").append(inside).append(u"</QuoteItem>");
    return text + u"</QuoteItems>";
}

} // namespace

TEST_CASE("QuoteItems: 32,768 items are read, and reached by every 16-bit position")
{
    const auto items = New<QuoteItemsDef>();
    items->ParseXML(Items(32768));
    CHECK(items->Count() == 32768);
    CHECK(items->QuoteItems(32767)->ItemNo() == 1);
}

TEST_CASE("QuoteItems: 32,769 items raise 6 before any is added, and so do a hundred thousand")
{
    const auto items = New<QuoteItemsDef>();
    items->Add()->Code(u"before");
    CHECK(RaisedBy([&] { items->ParseXML(Items(32769)); }) == "6 QuoteItemsDef.ParseXML");
    CHECK(RaisedBy([&] { items->ParseXML(Items(100000)); }) == "6 QuoteItemsDef.ParseXML");
    CHECK(items->Count() == 1);
    CHECK(items->QuoteItems(0)->Code() == u"before");
}

TEST_CASE("QuoteItems: the refusal names the element and how many there are")
{
    try {
        New<QuoteItemsDef>()->ParseXML(Items(32769));
        FAIL("nothing was raised");
    } catch (const Error& error) {
        CHECK(error.Description() == u"QuoteItem: 32769 elements are more than the 32768 that one text may have");
    }
}

TEST_CASE("QuoteItems: the limit is one text's: added one by one, or read in turn, there may be more")
{
    const auto items = New<QuoteItemsDef>();
    items->ParseXML(Items(32768));
    items->ParseXML(Items(2));
    items->Add();
    CHECK(items->Count() == 32771);
    CHECK(items->QuoteItems(32767)->ItemNo() == 1); // the last that a position reaches
    CHECK(items->Serialise().size() > 32771 * 100);
}

TEST_CASE("QuoteItem: a kind record that is first used after reading is as if it had been read")
{
    const auto item = New<QuoteItem>();
    item->ParseXML(u"<QuoteItem><Towing><TowingValue>1</TowingValue></Towing></QuoteItem>");
    const Text before = item->Serialise();
    CHECK(item->Repair()->Category() == QuoteHoursTypeEnum::Repair);
    CHECK(item->Repair()->Hours() == 0);
    CHECK(item->Part()->PartSource()->Category() == PartSourceTypeEnum::Aftermarket);
    CHECK(item->Serialise() == before);
}

TEST_CASE("QuoteItem: an amount that is infinite or no number raises 6 where it is written")
{
    const auto items = New<QuoteItemsDef>();
    const auto item = items->Add();
    item->QuoteItemValue(std::numeric_limits<double>::infinity());
    CHECK(RaisedBy([&] { items->Serialise(); }) == "6 QuoteItem.Serialise");
    item->QuoteItemValue(0);
    item->RemoveReplace()->Hours(std::numeric_limits<double>::quiet_NaN());
    CHECK(RaisedBy([&] { items->Serialise(); }) == "6 QuoteHoursDef.Serialise");
}

TEST_CASE("QuoteItem: the enumerations keep their gaps")
{
    const auto has = [](const EnumInfo& info, std::int32_t value) {
        return std::ranges::find(info.values, value, &Enumerator::value) != info.values.end();
    };
    CHECK_FALSE(has(UpdateStatusEnumInfo, 2));
    CHECK_FALSE(has(QuoteHoursTypeEnumInfo, 3));
    CHECK(UpdateStatusEnumInfo.values.size() == 5);
    CHECK(static_cast<int>(UpdateStatusEnum::Added) == 3);
    CHECK(static_cast<int>(UpdateStatusEnum::Deleted) == 5);
    CHECK(QuoteHoursTypeEnumInfo.values.size() == 4);
    CHECK(static_cast<int>(QuoteHoursTypeEnum::None) == 4);
    CHECK(QuoteItemTypeEnumInfo.values.size() == 8);
    CHECK(PartSourceTypeEnumInfo.values.size() == 4);
}

TEST_CASE("QuoteItems: as JSON a list is the array of its items")
{
    const auto items = New<QuoteItemsDef>();
    items->ParseXML(Items(2, u"<ItemNo>7</ItemNo><Repair/>"));
    const std::string json = ToJson(*items);
    CHECK(json.starts_with("{\"QuoteItems\":[{\"ItemNo\":7,"));
    CHECK(json.find("\"QuoteItemType\":\"QuoteItemRepair\"") != std::string::npos);
    CHECK(json.ends_with("\"Count\":2}"));
}
