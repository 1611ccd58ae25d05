#include "ErrorTable.h"

#include <limits>
#include <string>
#include <utility>
#include <vector>

#include "DisplayText.h"
#include "Table.h"
#include "varnex3/core/Conversions.h"

namespace varnex3::tool {

namespace {

// What one kind of error says; only the first has a field.
struct Fault
{
    std::string_view kind;
    Text description;
    Text field;
    Text value;

    bool IsTold() const { return IsSet(description) || IsSet(field) || IsSet(value); }
};

// "A message is missing (expected 402, received 403)".
Text InWords(const ErrorDetailsDefMessageOrderError& order)
{
    if (order.ExpectedMessageNo() == 0 && order.ReceivedMessageNo() == 0)
        return order.Description();
    const Text numbers = u"(expected " + ToText(Variant(order.ExpectedMessageNo())) + u", received "
                         + ToText(Variant(order.ReceivedMessageNo())) + u")";
    return IsSet(order.Description()) ? order.Description() + u" " + numbers : numbers;
}

// Those that are told; one without anything for a detail that has only a severity.
std::vector<Fault> FaultsOf(const ErrorDetailsItem& item)
{
    const auto& content = item.DataContentError();
    std::vector<Fault> faults = {
        {"Data content", content->Description(), content->ElementName(), content->Value()},
        {"Message order", InWords(*item.MessageOrderError()), {}, {}},
        {"Message type", item.MessageTypeError()->Description(), {}, {}},
        {"Miscellaneous", item.MiscellaneousError()->Description(), {}, {}},
    };
    std::erase_if(faults, [](const Fault& fault) { return !fault.IsTold(); });
    if (faults.empty())
        faults.emplace_back();
    return faults;
}

std::string SeverityOf(const ErrorDetailsItem& item)
{
    const Text& words = item.SeverityDescription();
    return Printable(IsSet(words) ? words + u" (" + item.Severity() + u")" : item.Severity());
}

void AddRows(Table& table, int number, const ErrorDetailsItem& item)
{
    std::string first = std::to_string(number);
    for (const Fault& fault : FaultsOf(item))
        table.Add({{std::exchange(first, {})},
                   {SeverityOf(item)},
                   {std::string(fault.kind)},
                   {Printable(fault.description)},
                   {Printable(fault.field)},
                   {Printable(fault.value)}});
}

} // namespace

void PrintErrors(FactSheet& sheet, ErrorDetailsDef& errors)
{
    Table table({{"No", 0, 90, true},
                 {"Severity", 8, 95, false, true},
                 {"Kind", 0, 70},
                 {"Description", 20, 100, false, true},
                 {"Field", 8, 85, false, true},
                 {"Value", 6, 80, false, true}});
    std::int32_t number = 0;
    while (number <= std::numeric_limits<std::int16_t>::max()) { // no position reaches further
        const Ref<ErrorDetailsItem> item = errors.ErrorItems(static_cast<std::int16_t>(number));
        if (!item)
            break;
        AddRows(table, ++number, *item);
    }
    if (number == 0)
        return;
    table.RemoveEmptyColumns();
    table.Print(sheet.Begin());
    if (errors.Count() > number)
        sheet.Fact("More", ToText(Variant(errors.Count() - number)));
}

} // namespace varnex3::tool
