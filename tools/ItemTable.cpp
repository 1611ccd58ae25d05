#include "ItemTable.h"

#include <algorithm>
#include <iterator>
#include <limits>

#include "DisplayText.h"
#include "Summary.h"
#include "Table.h"
#include "varnex3/core/Conversions.h"

namespace varnex3::tool {

namespace {

struct KindNames
{
    std::string_view shortName;
    std::string_view name;
};

constexpr KindNames kKinds[] = {
    {"R&R", "Remove, replace"},       {"Repair", "Repair"}, {"Paint", "Paint labour"},
    {"Materials", "Paint materials"}, {"Part", "Part"},     {"Misc", "Miscellaneous"},
    {"Mechanical", "Mechanical"},     {"Towing", "Towing"},
};

// What an item's kind says, each in its column.
struct Work
{
    double hours = 0;
    double rate = 0;
    double amount = 0;
    Text detail;
};

Text Joined(std::initializer_list<Text> parts)
{
    Text joined;
    for (const Text& part : parts)
        if (IsSet(part))
            joined += (joined.empty() ? u"" : u", ") + part;
    return joined;
}

Work WorkOf(const QuoteHoursDef& hours) { return {hours.Hours(), hours.HourlyRate(), 0, {}}; }

Work WorkOf(const QuoteItemPaintLabour& paint)
{
    return {paint.Hours(), paint.HourlyRate(), 0, paint.OtherPaintGroup()};
}

Text SourceInWords(QuoteItemPartPartSource& source)
{
    const PartSourceTypeEnum category = source.Category();
    const Text words = ToUtf16(EnumeratorText(EnumerationOf(category), static_cast<std::int32_t>(category)));
    return IsSet(source.PartNumber()) ? words + u" " + source.PartNumber() : words;
}

Work WorkOf(const QuoteItemPart& part)
{
    const Text quantity = ToText(Variant(part.PartQuantity())) + u" pc";
    return {0, 0, part.PartValue(), Joined({quantity, part.PartOrientation(), SourceInWords(*part.PartSource())})};
}

Work WorkOf(const QuoteItemMiscellaneous& other)
{
    const auto& sublet = other.Sublet();
    return {0, 0, other.MiscellaneousValue(), Joined({sublet->SubletType(), sublet->SubletRepairerName()})};
}

Work WorkOf(const QuoteItem& item)
{
    switch (item.QuoteItemType()) {
    case QuoteItemTypeEnum::QuoteItemRemoveReplace:
        return WorkOf(*item.RemoveReplace());
    case QuoteItemTypeEnum::QuoteItemRepair:
        return WorkOf(*item.Repair());
    case QuoteItemTypeEnum::QuoteItemPaintLabour:
        return WorkOf(*item.PaintLabour());
    case QuoteItemTypeEnum::QuoteItemPaintMaterials:
        return {0, 0, item.PaintMaterials()->PaintValue(), {}};
    case QuoteItemTypeEnum::QuoteItemPart:
        return WorkOf(*item.Part());
    case QuoteItemTypeEnum::QuoteItemMiscellaneous:
        return WorkOf(*item.Miscellaneous());
    case QuoteItemTypeEnum::QuoteItemMechanical:
        return WorkOf(*item.Mechanical());
    case QuoteItemTypeEnum::QuoteItemTowing:
        return {0, 0, item.Towing()->TowingValue(), {}};
    }
    return {};
}

// Reading gives no item another kind than these.
std::size_t KindOf(const QuoteItem& item) { return static_cast<std::size_t>(item.QuoteItemType()); }

std::string Amount(double amount) { return amount == 0 ? std::string() : ToUtf8(FormatAmount(amount)); }

// All items; a position is a 16-bit integer.
std::vector<Ref<QuoteItem>> AllOf(QuoteItemsDef& items)
{
    std::vector<Ref<QuoteItem>> all;
    const std::int32_t reachable = std::min<std::int32_t>(items.Count(), std::numeric_limits<std::int16_t>::max() + 1);
    all.reserve(static_cast<std::size_t>(reachable));
    for (std::int32_t i = 0; i < reachable; ++i)
        all.push_back(items.QuoteItems(static_cast<std::int16_t>(i)));
    return all;
}

std::vector<Cell> RowOf(const QuoteItem& item)
{
    const Work work = WorkOf(item);
    return {{std::to_string(item.ItemNo())},
            {Printable(item.Code())},
            {Printable(item.Description())},
            {std::string(kKinds[KindOf(item)].shortName)},
            {Amount(work.hours)},
            {Amount(work.rate)},
            {Amount(work.amount)},
            {ToUtf8(FormatAmount(item.QuoteItemValue()))},
            {Printable(work.detail), Style::Faint},
            {Printable(item.UpdateStatus())},
            {Printable(item.Comment()), Style::Faint}};
}

// "3 items, 10.50 hours, 867.50".
std::string InWords(std::size_t count, double hours, double value)
{
    const std::string time = hours == 0 ? "" : ", " + Amount(hours) + " hours";
    return Plural(count, "item") + time + ", " + ToUtf8(FormatAmount(value));
}

} // namespace

void PrintItems(FactSheet& sheet, QuoteItemsDef& items)
{
    const std::vector<Ref<QuoteItem>> all = AllOf(items);
    if (all.empty())
        return;
    Table table({{"No", 0, 90, true},
                 {"Code", 0, 40},
                 {"Description", 20, 100},
                 {"Kind", 0, 70},
                 {"Hours", 0, 60, true},
                 {"Rate", 0, 50, true},
                 {"Amount", 0, 55, true},
                 {"Value", 0, 95, true},
                 {"Detail", 8, 30},
                 {"Status", 5, 20},
                 {"Comment", 8, 10}});
    for (const Ref<QuoteItem>& item : all)
        table.Add(RowOf(*item));
    table.RemoveEmptyColumns();
    table.Print(sheet.Begin());
    for (const Ref<QuoteItem>& item : all)
        if (IsSet(item->ErrorMessage()))
            sheet.Fact("Item " + std::to_string(item->ItemNo()), u"has more than one kind: the last one counts");
}

void PrintItemsByKind(FactSheet& sheet, QuoteItemsDef& items)
{
    struct Sum
    {
        std::size_t count = 0;
        double hours = 0;
        double value = 0;
        void Add(const QuoteItem& item)
        {
            ++count;
            hours += WorkOf(item).hours;
            value += item.QuoteItemValue();
        }
    };
    Sum sums[std::size(kKinds)];
    Sum whole;
    for (const Ref<QuoteItem>& item : AllOf(items)) {
        sums[KindOf(*item)].Add(*item);
        whole.Add(*item);
    }
    for (std::size_t kind = 0; kind < std::size(kKinds); ++kind)
        if (sums[kind].count > 0)
            sheet.Fact(kKinds[kind].name, ToUtf16(InWords(sums[kind].count, sums[kind].hours, sums[kind].value)));
    if (whole.count > 0)
        sheet.Fact("All", ToUtf16(InWords(whole.count, whole.hours, whole.value)));
}

} // namespace varnex3::tool
