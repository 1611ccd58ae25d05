// The answers of a database, copied out of a statement.
#pragma once

#include <vector>

#include "varnex3/core/RowSet.h"
#include "varnex3/services/DatabaseConnection.h"

namespace varnex3 {

// Reads the current result of a statement. Cells are int16, int32, double (also exact numbers and 64-bit integers),
// Boolean, date and text (everything else); null is Empty.
class ResultReader
{
public:
    ResultReader(DatabaseConnection& connection_, const OdbcHandle& statement_);

    // Whether there are columns; a result of a command that only changes rows has none.
    bool IsRowSet() const { return !columns.empty(); }

    std::vector<Text> ColumnNames() const;

    // The next row. False behind the last one.
    bool ReadRow(RowSet::Row& row);

    std::vector<RowSet::Row> ReadRows();

private:
    struct Column
    {
        Text name;
        SQLSMALLINT type = 0;
    };

    Column Describe(SQLUSMALLINT number);
    Variant Cell(SQLUSMALLINT number, SQLSMALLINT type);
    template <class T>
    bool Get(SQLUSMALLINT number, SQLSMALLINT kind, T& value);
    Variant DateCell(SQLUSMALLINT number);
    Variant TimeCell(SQLUSMALLINT number);
    Variant TextCell(SQLUSMALLINT number);

    DatabaseConnection& connection;
    const OdbcHandle& statement;
    const OdbcFunctions& odbc;
    std::vector<Column> columns;
};

} // namespace varnex3
