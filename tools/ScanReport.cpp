#include "ScanReport.h"

#include <algorithm>
#include <limits>
#include <map>

#include "DisplayText.h"
#include "Summary.h"
#include "Table.h"
#include "varnex3/core/Conversions.h"

namespace varnex3::tool {

namespace {

constexpr Name kFine;
constexpr Name kBroken = "broken";
constexpr Name kUnreadable = "unreadable";
constexpr std::size_t kTypeColumn = 1; // says of a file that is not fine what it is instead

Name StateOf(const MessageFile& file) { return file.IsBroken() ? kBroken : file.IsUnreadable() ? kUnreadable : kFine; }

// What is no number comes behind all numbers.
double NumberOrLast(const Text& text)
{
    try {
        return NumberFrom(text);
    } catch (const Error&) {
        return std::numeric_limits<double>::infinity();
    }
}

} // namespace

std::span<const ScanColumn> ScanColumns()
{
    static constexpr ScanColumn columns[] = {
        {"name", "File", "FileName", 24, 7, false},
        {"type", "Type", "MessageDescription", 17, 6, false},
        {"number", "No", "MessageNo", 0, 3, true},
        {"registration", "Reg. no", "Registration", 7, 5, false},
        {"claim", "Claim", "ClaimNo", 14, 4, false},
        {"customer", "Customer", "Customer", 12, 2, false},
        {"vehicle", "Vehicle", "VehicleDesciption", 12, 1, false},
    };
    return columns;
}

ScanReport::ScanReport(Form form_, Name sortKey) : form(form_)
{
    const auto column = std::ranges::find(ScanColumns(), sortKey, &ScanColumn::key);
    sortColumn = static_cast<std::size_t>(column - ScanColumns().begin());
}

void ScanReport::Add(const MessageFile& file)
{
    Entry entry;
    for (const ScanColumn& column : ScanColumns())
        entry.values.push_back(ValueOf(*file.message, column.property));
    entry.type = file.message->MessageTypeID();
    entry.state = StateOf(file);
    if (!file.IsFine()) {
        entry.values[kTypeColumn].clear();
        entry.finding = FindingOf(file, file.message->FileName());
    }
    if (form == Form::Json)
        entry.json = JsonLineOf(file);
    entries.push_back(std::move(entry));
}

bool ScanReport::Precedes(const Entry& a, const Entry& b) const
{
    const Text& first = a.values[sortColumn];
    const Text& second = b.values[sortColumn];
    if (first.empty() || second.empty())
        return !first.empty() && second.empty();
    if (ScanColumns()[sortColumn].isNumber && NumberOrLast(first) != NumberOrLast(second))
        return NumberOrLast(first) < NumberOrLast(second);
    return first < second;
}

void ScanReport::Sort()
{
    std::ranges::stable_sort(entries, [this](const Entry& a, const Entry& b) { return Precedes(a, b); });
}

std::size_t ScanReport::CountOf(Name state) const
{
    return static_cast<std::size_t>(std::ranges::count(entries, state, &Entry::state));
}

void ScanReport::Print(Terminal& terminal) const
{
    if (form == Form::Json) {
        for (const Entry& entry : entries)
            terminal.Line(entry.json);
        return;
    }
    if (!entries.empty()) {
        PrintTable(terminal);
        PrintFindings(terminal);
        PrintTypes(terminal);
    }
    PrintTotal(terminal);
}

void ScanReport::PrintTable(Terminal& terminal) const
{
    std::vector<Column> columns;
    for (const ScanColumn& column : ScanColumns())
        columns.push_back({std::string(column.title), column.leastWidth, column.importance, column.isNumber});
    Table table(std::move(columns));
    for (const Entry& entry : entries) {
        std::vector<Cell> row;
        for (const Text& value : entry.values)
            row.push_back({Printable(value)});
        if (entry.state != kFine)
            row[kTypeColumn] = {std::string(entry.state), Style::Bad};
        table.Add(std::move(row));
    }
    table.Print(terminal);
    terminal.Line();
}

void ScanReport::PrintFindings(Terminal& terminal) const
{
    if (CountOf(kFine) == entries.size())
        return;
    for (const Entry& entry : entries)
        if (entry.state != kFine)
            terminal.Paragraph(entry.finding, 4);
    terminal.Line();
}

void ScanReport::PrintTypes(Terminal& terminal) const
{
    std::map<XaloMessageTypeEnum, std::size_t> counts;
    std::map<XaloMessageTypeEnum, std::string> names;
    for (const Entry& entry : entries)
        if (entry.state == kFine) {
            ++counts[entry.type];
            names[entry.type] = Printable(entry.values[kTypeColumn]);
        }
    if (counts.empty())
        return;
    Table table({{"Type"}, {"Files", 0, 0, true}});
    for (const auto& [type, count] : counts)
        table.Add({{names[type]}, {std::to_string(count)}});
    table.Print(terminal);
    terminal.Line();
}

void ScanReport::PrintTotal(Terminal& terminal) const
{
    const std::size_t broken = CountOf(kBroken);
    const std::size_t unreadable = CountOf(kUnreadable);
    std::string total = Plural(entries.size(), "message file");
    if (broken > 0)
        total += ", " + std::to_string(broken) + " broken";
    if (unreadable > 0)
        total += ", " + std::to_string(unreadable) + " unreadable";
    const bool isFine = broken + unreadable == 0;
    for (const std::string& line : Wrapped(total, terminal.Width()))
        terminal.Line(terminal.Styled(isFine ? Style::Good : Style::Bad, line));
}

} // namespace varnex3::tool
