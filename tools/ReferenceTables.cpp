#include "ReferenceTables.h"

#include <limits>
#include <vector>

#include "DisplayText.h"
#include "Table.h"

namespace varnex3::tool {

namespace {

// What positions reach of a list.
template <class List>
auto ItemsOf(List& list)
{
    std::vector<decltype(list.Items(0))> items;
    for (std::int32_t i = 0; i <= std::numeric_limits<std::int16_t>::max(); ++i) {
        auto item = list.Items(static_cast<std::int16_t>(i));
        if (!item)
            break;
        items.push_back(std::move(item));
    }
    return items;
}

// Why those are not all: there are more than a count can say.
template <class List>
void PrintWhatIsMissing(FactSheet& sheet, const List& list)
{
    try {
        static_cast<void>(list.Count());
    } catch (const Error& error) {
        sheet.Fact("More", error.Description());
    }
}

void PrintType(FactSheet& sheet, ReferenceDataDefDataType& type)
{
    const auto values = ItemsOf(type);
    const std::string name = IsSet(type.NameAttribute()) ? Printable(type.NameAttribute()) : "Without a name";
    const std::string title = name + ": " + Plural(values.size(), "code");
    sheet.Part(title);
    Terminal& terminal = sheet.Begin();
    if (values.empty())
        return;
    Table table({{"Code", 8, 100, false, true}, {"Description", 20, 90, false, true}});
    for (const auto& value : values)
        table.Add({{Printable(value->Code())}, {Printable(value->Description())}});
    table.Print(terminal);
    PrintWhatIsMissing(sheet, type);
}

} // namespace

void PrintReferenceData(FactSheet& sheet, ReferenceDataDef& data)
{
    const auto types = ItemsOf(data);
    if (types.empty())
        sheet.Fact("Data types", u"none");
    for (const auto& type : types)
        PrintType(sheet, *type);
    PrintWhatIsMissing(sheet, data);
}

} // namespace varnex3::tool
