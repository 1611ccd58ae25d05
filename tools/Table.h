// A table that fits a width: columns are narrowed as far as they can be read, then the least important ones left out.
#pragma once

#include <cstddef>
#include <string>
#include <vector>

#include "Terminal.h"

namespace varnex3::tool {

struct Column
{
    std::string title;
    std::size_t leastWidth = 0; // it is left out rather than cut further; 0 when it must not be cut
    int importance = 0;         // the lowest goes first
    bool isNumber = false;      // set to the right
    bool isWrapped = false;     // a longer text goes on below itself, nothing of it is cut off
};

struct Cell
{
    std::string text; // printable
    Style style = Style::Plain;
};

class Table
{
public:
    explicit Table(std::vector<Column> columns);

    // A cell for every column.
    void Add(std::vector<Cell> row);

    // Takes away the columns without a text in any row.
    void RemoveEmptyColumns();

    void Print(Terminal& terminal) const;

private:
    using Widths = std::vector<std::size_t>; // 0 for a column that is left out

    Widths NaturalWidths() const;
    Widths LeastWidths(Widths natural) const;
    Widths WidthsWithin(std::size_t available) const;

    // Leaves out the least important columns until the rest fits, but for the most important one, which it returns.
    std::size_t LeaveOut(Widths& widths, std::size_t available) const;

    // The lines that a row takes.
    std::vector<std::vector<Cell>> LinesOf(const std::vector<Cell>& row, const Widths& widths) const;

    void PrintRow(Terminal& terminal, const std::vector<Cell>& row, const Widths& widths) const;
    void PrintLine(Terminal& terminal, const std::vector<Cell>& line, const Widths& widths) const;

    std::vector<Column> columns;
    std::vector<std::vector<Cell>> rows;
};

} // namespace varnex3::tool
