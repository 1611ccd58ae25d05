#include "RecordTree.h"

#include <algorithm>
#include <string>

#include "DisplayText.h"
#include "Summary.h"
#include "varnex3/core/Conversions.h"

namespace varnex3::tool {

namespace {

constexpr std::size_t kIndent = 2;
constexpr std::size_t kValueColumn = 24;

std::string ShownValue(const Type& type, const Variant& value)
{
    const auto* const date = std::get_if<Date>(&value);
    if (date && !IsSet(*date)) // the zero date
        return {};
    return type.enumeration ? EnumeratorText(*type.enumeration, ToInt32(value)) : Printable(ToText(value));
}

std::string ItemAt(Record& record, Name property, std::int32_t position)
{
    Variant index = position;
    return Printable(ToText(Get(record, property, {&index, 1})));
}

bool IsListOfFields(const ClassInfo& info)
{
    return FindMember(info, "Count") && FindMember(info, "Fields") && FindMember(info, "Values");
}

void PrintFields(Terminal& terminal, std::size_t depth, Record& list)
{
    const std::int32_t count = ToInt32(Get(list, "Count"));
    for (std::int32_t i = 0; i < count; ++i)
        PrintField(terminal, depth, ItemAt(list, "Fields", i), ItemAt(list, "Values", i));
}

void PrintChild(Terminal& terminal, std::size_t depth, Name name, const Ref<Record>& child)
{
    const bool isNothing = !child || (IsListOfFields(child->Class()) && ToInt32(Get(*child, "Count")) == 0);
    if (isNothing)
        return PrintField(terminal, depth, name, {});
    PrintGroup(terminal, depth, name);
    PrintRecord(terminal, depth + 1, *child);
}

} // namespace

void PrintGroup(Terminal& terminal, std::size_t depth, std::string_view name)
{
    const std::size_t indent = std::min(depth * kIndent, terminal.Width() / 2);
    terminal.Line(Cut(std::string(indent, ' ').append(name), terminal.Width()));
}

void PrintField(Terminal& terminal, std::size_t depth, std::string_view name, std::string_view value)
{
    const std::size_t width = terminal.Width();
    const std::size_t column = std::min(kValueColumn, width / 2);
    const std::string label = std::string(std::min(depth * kIndent, column / 2), ' ').append(name);
    const bool isShort = DisplayWidth(label) < column;
    if (!isShort)
        terminal.Line(Cut(label, width));

    std::string before = isShort ? label + std::string(column - DisplayWidth(label), ' ') : std::string(column, ' ');
    for (const std::string& line : Wrapped(value.empty() ? "-" : value, width - column)) {
        terminal.Line(before + line);
        before.assign(column, ' ');
    }
}

void PrintRecord(Terminal& terminal, std::size_t depth, Record& record)
{
    if (IsListOfFields(record.Class()))
        return PrintFields(terminal, depth, record);
    for (const Member& member : record.Class().members) {
        if (!member.IsProperty() || member.IsIndexed())
            continue;
        const Variant value = member.get(&record, {});
        if (const auto* const child = std::get_if<Ref<Record>>(&value))
            PrintChild(terminal, depth, member.name, *child);
        else
            PrintField(terminal, depth, member.name, ShownValue(member.type, value));
    }
}

} // namespace varnex3::tool
