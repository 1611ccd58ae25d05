#include "varnex3/core/RowSet.h"

#include <algorithm>
#include <optional>
#include <utility>

#include "varnex3/core/Conversions.h"

namespace varnex3 {

namespace {

struct Criterion
{
    TextView column;
    TextView value;
};

// Nothing when the text has another form than: column = 'value'.
std::optional<Criterion> CriterionFrom(TextView text)
{
    const std::size_t sign = text.find(u'=');
    if (sign == TextView::npos)
        return std::nullopt;
    const TextView column = Trimmed(text.substr(0, sign));
    TextView value = Trimmed(text.substr(sign + 1));
    if (column.empty() || value.size() < 2 || value.front() != u'\'' || value.back() != u'\'')
        return std::nullopt;
    value = value.substr(1, value.size() - 2);
    return value.find(u'\'') == TextView::npos ? std::optional(Criterion{column, value}) : std::nullopt;
}

bool Equals(const Variant& cell, TextView value)
{
    return !IsEmpty(cell) && EqualsIgnoringCase(ToText(cell), value); // a null equals nothing, not even ''
}

} // namespace

RowSet::RowSet(std::vector<Text> columns_, std::vector<Row> rows_, Form form_)
    : columns(std::move(columns_)), rows(std::move(rows_)), form(form_), isOpen(true)
{}

void RowSet::MoveNext()
{
    RequireRow("RowSet.MoveNext");
    ++current;
}

void RowSet::Find(TextView criterion)
{
    if (!isOpen)
        return;
    const std::optional<Criterion> wanted = CriterionFrom(criterion);
    if (!wanted)
        Raise(kMalformedCriterion, "RowSet.Find",
              Quoted(criterion) + u" is not a column, an equals sign and a value between apostrophes");
    const std::size_t column = ColumnNamed(wanted->column, "RowSet.Find");
    while (!EndOfRows() && !Equals(rows[current][column], wanted->value))
        ++current;
}

const Variant& RowSet::Field(TextView column) const
{
    const std::size_t i = ColumnNamed(column, "RowSet.Field");
    RequireRow("RowSet.Field");
    return rows[current][i];
}

void RowSet::SetField(TextView column, Variant value)
{
    if (!IsUpdatable())
        Raise(kNotUpdatable, "RowSet.SetField", u"the row set is not updatable");
    const std::size_t i = ColumnNamed(column, "RowSet.SetField");
    RequireRow("RowSet.SetField");
    changed.resize(rows.size());
    rows[current][i] = std::move(value);
    changed[current] = true;
}

bool RowSet::IsChanged() const { return current < changed.size() && changed[current]; }

std::size_t RowSet::ColumnNamed(TextView column, Name operation) const
{
    const auto found = std::ranges::find_if(columns, [&](TextView name) { return EqualsIgnoringCase(name, column); });
    if (found == columns.end())
        Raise(kItemNotFound, operation, u"the row set has no column " + Quoted(column));
    return static_cast<std::size_t>(found - columns.begin());
}

void RowSet::RequireRow(Name operation) const
{
    if (EndOfRows())
        Raise(kNoCurrentRow, operation, u"there is no current row");
}

} // namespace varnex3
