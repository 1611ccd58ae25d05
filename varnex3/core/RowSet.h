// Rows that a database answered with, copied: nothing connects them to it any more.
#pragma once

#include <cstddef>
#include <vector>

#include "varnex3/core/Error.h"
#include "varnex3/core/Text.h"
#include "varnex3/core/Variant.h"

namespace varnex3 {

// What a row set raises, beside the numbers of Error.h, by the numbers that hosts of such sets know.
inline constexpr ErrorNumber kMalformedCriterion{3001};
inline constexpr ErrorNumber kNoCurrentRow{3021};
inline constexpr ErrorNumber kNotUpdatable{3251};
inline constexpr ErrorNumber kItemNotFound{3265};

// A table with a cursor. The cursor stands on a row or behind the last one; in a new set on the first row. Names of
// columns are found in any letter case. A set that was never opened has no columns and no rows; searching it finds
// nothing and raises nothing.
//
// The cells are text, numbers, Booleans and dates; a null is Empty.
class RowSet
{
public:
    using Row = std::vector<Variant>;

    enum class Form
    {
        ReadOnly,
        Updatable
    };

    // A set that was never opened.
    RowSet() = default;

    // An open set. Precondition: each row has a cell for each column.
    RowSet(std::vector<Text> columns_, std::vector<Row> rows_, Form form_ = Form::ReadOnly);

    bool IsOpen() const { return isOpen; }
    bool IsUpdatable() const { return form == Form::Updatable; }
    std::size_t Count() const { return rows.size(); }
    const std::vector<Text>& Columns() const { return columns; }

    // Whether the cursor is behind the last row; always so in a set without rows.
    bool EndOfRows() const { return current >= rows.size(); }

    void MoveFirst() { current = 0; }

    // Raises kNoCurrentRow behind the last row.
    void MoveNext();

    // Moves to the first row, from the current one on, whose cell equals the value, or behind the last row:
    // Find(u"Code = 'cp'"). Upper and lower case are alike; a null equals nothing. The criterion is a column, an equals
    // sign and a value between apostrophes that has none inside. Raises kMalformedCriterion for another form and
    // kItemNotFound for an unknown column.
    void Find(TextView criterion);

    // A cell of the current row. Raises kItemNotFound for an unknown column, kNoCurrentRow behind the last row.
    const Variant& Field(TextView column) const;

    // Changes a cell of the current row, in an updatable set only: kNotUpdatable otherwise. The change is kept in this
    // set, as in a batch that is not yet sent; nothing is written to the database.
    void SetField(TextView column, Variant value);

    // Whether a cell of the current row was changed.
    bool IsChanged() const;

private:
    std::size_t ColumnNamed(TextView column, Name operation) const;
    void RequireRow(Name operation) const;

    std::vector<Text> columns;
    std::vector<Row> rows;
    std::vector<bool> changed; // a row each, once one was changed
    std::size_t current = 0;
    Form form = Form::ReadOnly;
    bool isOpen = false;
};

} // namespace varnex3
