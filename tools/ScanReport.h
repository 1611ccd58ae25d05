// The files of an inbox in order: as a table with findings and totals for a person, as a line of JSON each for
// programs.
#pragma once

#include <cstddef>
#include <span>
#include <string>
#include <vector>

#include "MessageFile.h"
#include "Terminal.h"

namespace varnex3::tool {

// A column of the table, which the files can be put in order by.
struct ScanColumn
{
    Name key;
    Name title;
    Name property;          // of MessageDef
    std::size_t leastWidth; // 0 when it must not be cut
    int importance;         // the lowest is left out first where there is little room
    bool isNumber;
};

std::span<const ScanColumn> ScanColumns();

class ScanReport
{
public:
    enum class Form
    {
        Table,
        Json
    };

    // Precondition: the key is that of a column.
    ScanReport(Form form, Name sortKey);

    void Add(const MessageFile& file);

    // To be called once all files are there. Files without the value that orders them come last; those with the same
    // value stay in the order of adding.
    void Sort();

    void Print(Terminal& terminal) const;

private:
    struct Entry
    {
        std::vector<Text> values; // one for each column
        XaloMessageTypeEnum type{};
        Name state; // of a file that is not fine, in one word
        std::string finding;
        std::string json;
    };

    bool Precedes(const Entry& a, const Entry& b) const;
    std::size_t CountOf(Name state) const;
    void PrintTable(Terminal& terminal) const;
    void PrintFindings(Terminal& terminal) const;
    void PrintTypes(Terminal& terminal) const;
    void PrintTotal(Terminal& terminal) const;

    Form form;
    std::size_t sortColumn = 0;
    std::vector<Entry> entries;
};

} // namespace varnex3::tool
