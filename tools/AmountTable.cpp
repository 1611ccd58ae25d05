#include "AmountTable.h"

#include <cmath>
#include <limits>
#include <utility>

#include "PropertyFacts.h"
#include "Table.h"
#include "varnex3/core/Conversions.h"
#include "varnex3/quote/OwnersContributionToCollectDef.h"

namespace varnex3::tool {

namespace {

bool IsAmount(const Member& member)
{
    const bool isContribution = member.type.name == OwnersContributionToCollectDef::ClassName;
    return member.IsProperty() && (member.type.kind == Kind::Double || isContribution);
}

double AmountOf(Record& record, Name property)
{
    const Variant value = Get(record, property);
    const auto* const contribution = std::get_if<Ref<Record>>(&value);
    return contribution ? ToDouble(Get(**contribution, "Value")) : ToDouble(value);
}

bool IsTotal(Name property) { return property.starts_with("Total"); }

// Expected less invoiced, if both are known and their difference is a number.
std::string Difference(const std::vector<double>& known)
{
    const double difference = known.size() == 2 ? known[1] - known[0] : std::numeric_limits<double>::infinity();
    return std::isfinite(difference) ? ToUtf8(FormatAmount(difference)) : std::string();
}

// What is known of an amount; nothing when no column has it, unless it is a total.
std::vector<Cell> RowOf(const std::vector<AmountColumn>& columns, Name property)
{
    std::vector<Cell> row = {{"  " + std::string(LabelOf(property))}};
    std::vector<double> known;
    bool isTold = IsTotal(property);
    for (const AmountColumn& column : columns) {
        const double amount = AmountOf(*column.record, property);
        const bool isKnown = column.isWhole || amount != 0;
        if (isKnown)
            known.push_back(amount);
        row.push_back({isKnown ? ToUtf8(FormatAmount(amount)) : std::string()});
        isTold = isTold || amount != 0;
    }
    if (columns.size() == 2)
        row.push_back({Difference(known)});
    return isTold ? row : std::vector<Cell>();
}

Table TableOf(const std::vector<AmountColumn>& columns)
{
    std::vector<Column> titles = {{"", 0, 100}};
    for (const AmountColumn& column : columns)
        titles.push_back({column.title, 0, 90, true});
    if (columns.size() == 2)
        titles.push_back({"Difference", 0, 80, true});
    return Table(std::move(titles));
}

} // namespace

void PrintAmounts(FactSheet& sheet, const std::vector<AmountColumn>& columns)
{
    if (columns.empty())
        return;
    Table table = TableOf(columns);
    for (const Member& member : columns.front().record->Class().members)
        if (IsAmount(member))
            if (std::vector<Cell> row = RowOf(columns, member.name); !row.empty())
                table.Add(std::move(row));
    table.Print(sheet.Begin());
}

} // namespace varnex3::tool
