#include "Table.h"

#include <algorithm>
#include <numeric>
#include <utility>

#include "DisplayText.h"

namespace varnex3::tool {

namespace {

constexpr std::size_t kGap = 2;

std::size_t Total(const std::vector<std::size_t>& widths)
{
    std::size_t total = 0;
    for (const std::size_t width : widths)
        if (width > 0)
            total += width + (total > 0 ? kGap : 0);
    return total;
}

// Hands the columns that are left over to those that are cut, one by one.
void Grow(std::vector<std::size_t>& widths, const std::vector<std::size_t>& natural, std::size_t left)
{
    for (bool isGrowing = true; isGrowing;) {
        isGrowing = false;
        for (std::size_t i = 0; i < widths.size() && left > 0; ++i)
            if (widths[i] > 0 && widths[i] < natural[i]) {
                ++widths[i];
                --left;
                isGrowing = true;
            }
    }
}

std::string Padded(const std::string& text, std::size_t width, bool isNumber)
{
    const std::string blanks(width - std::min(width, DisplayWidth(text)), ' ');
    return isNumber ? blanks + text : text + blanks;
}

} // namespace

Table::Table(std::vector<Column> columns_) : columns(std::move(columns_)) {}

void Table::Add(std::vector<Cell> row) { rows.push_back(std::move(row)); }

void Table::RemoveEmptyColumns()
{
    for (std::size_t i = columns.size(); i-- > 0;) {
        if (std::ranges::any_of(rows, [i](const auto& row) { return !row[i].text.empty(); }))
            continue;
        const auto place = static_cast<std::ptrdiff_t>(i);
        columns.erase(columns.begin() + place);
        for (auto& row : rows)
            row.erase(row.begin() + place);
    }
}

Table::Widths Table::NaturalWidths() const
{
    Widths widths;
    for (std::size_t i = 0; i < columns.size(); ++i) {
        widths.push_back(DisplayWidth(columns[i].title));
        for (const auto& row : rows)
            widths[i] = std::max(widths[i], DisplayWidth(row[i].text));
    }
    return widths;
}

Table::Widths Table::WidthsWithin(std::size_t available) const
{
    const Widths natural = NaturalWidths();
    Widths widths = LeastWidths(natural);
    const std::size_t kept = LeaveOut(widths, available);
    widths[kept] = std::min(widths[kept], available);
    Grow(widths, natural, available - Total(widths));
    return widths;
}

Table::Widths Table::LeastWidths(Widths natural) const
{
    for (std::size_t i = 0; i < columns.size(); ++i)
        if (columns[i].leastWidth > 0)
            natural[i] = std::min(natural[i], columns[i].leastWidth);
    return natural;
}

std::size_t Table::LeaveOut(Widths& widths, std::size_t available) const
{
    std::vector<std::size_t> byImportance(columns.size());
    std::iota(byImportance.begin(), byImportance.end(), std::size_t{0});
    std::ranges::sort(byImportance, {}, [this](std::size_t i) { return columns[i].importance; });
    for (std::size_t i = 0; i + 1 < byImportance.size() && Total(widths) > available; ++i)
        widths[byImportance[i]] = 0;
    return byImportance.back();
}

std::vector<std::vector<Cell>> Table::LinesOf(const std::vector<Cell>& row, const Widths& widths) const
{
    std::vector<std::vector<Cell>> lines = {row};
    for (std::size_t i = 0; i < row.size(); ++i) {
        if (!columns[i].isWrapped || widths[i] == 0)
            continue;
        const std::vector<std::string> texts = Wrapped(row[i].text, widths[i]);
        if (lines.size() < texts.size())
            lines.resize(texts.size(), std::vector<Cell>(row.size()));
        for (std::size_t k = 0; k < texts.size(); ++k)
            lines[k][i] = {texts[k], row[i].style};
    }
    return lines;
}

void Table::PrintRow(Terminal& terminal, const std::vector<Cell>& row, const Widths& widths) const
{
    for (const std::vector<Cell>& line : LinesOf(row, widths))
        PrintLine(terminal, line, widths);
}

void Table::PrintLine(Terminal& terminal, const std::vector<Cell>& row, const Widths& widths) const
{
    std::string line;
    std::size_t blanks = 0; // written only once something follows: no blanks end a line
    for (std::size_t i = 0; i < row.size(); ++i) {
        if (widths[i] == 0)
            continue;
        const std::string text = Padded(Cut(row[i].text, widths[i]), widths[i], columns[i].isNumber);
        const std::size_t end = text.find_last_not_of(' ') + 1;
        if (end > 0)
            line += std::string(blanks, ' ') + terminal.Styled(row[i].style, text.substr(0, end));
        blanks = (end > 0 ? 0 : blanks) + (text.size() - end) + kGap;
    }
    terminal.Line(line);
}

void Table::Print(Terminal& terminal) const
{
    const Widths widths = WidthsWithin(terminal.Width());
    std::vector<Cell> titles;
    for (const Column& column : columns)
        titles.push_back({column.title, Style::Heading});
    PrintRow(terminal, titles, widths);
    for (const auto& row : rows)
        PrintRow(terminal, row, widths);
}

} // namespace varnex3::tool
