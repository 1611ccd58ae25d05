#include "varnex3/services/ResultReader.h"

#include <array>
#include <optional>

#include "varnex3/core/Conversions.h"

namespace varnex3 {

namespace {

constexpr SQLSMALLINT kTimeOfSqlServer = -154; // its driver's own codes for what ODBC has no room for
constexpr double kSecondsPerDay = 86400;

Variant DateOf(const SQL_TIMESTAMP_STRUCT& moment)
{
    const std::optional<Date> date =
        DateFrom(CivilDate{moment.year, moment.month, moment.day, moment.hour, moment.minute, moment.second});
    if (!date)
        throw Error(ErrorNumber::Overflow, {}, u"a date of the database is outside the years 100 to 9999");
    const double fraction = moment.fraction / 1e9 / kSecondsPerDay;
    return Date{date->serial < 0 ? date->serial - fraction : date->serial + fraction}; // see Date.h
}

} // namespace

ResultReader::ResultReader(DatabaseConnection& connection_, const OdbcHandle& statement_)
    : connection(connection_), statement(statement_), odbc(connection.Functions())
{
    SQLSMALLINT count = 0;
    connection.Require(odbc.NumResultCols(statement.Get(), &count), statement);
    for (SQLSMALLINT i = 1; i <= count; ++i)
        columns.push_back(Describe(static_cast<SQLUSMALLINT>(i)));
}

std::vector<Text> ResultReader::ColumnNames() const
{
    std::vector<Text> names;
    for (const Column& column : columns)
        names.push_back(column.name);
    return names;
}

bool ResultReader::ReadRow(RowSet::Row& row)
{
    const SQLRETURN result = odbc.Fetch(statement.Get());
    connection.Require(result, statement);
    if (result == SQL_NO_DATA)
        return false;
    row.clear();
    SQLUSMALLINT number = 0; // they are counted from 1
    for (const Column& column : columns)
        row.push_back(Cell(++number, column.type));
    return true;
}

std::vector<RowSet::Row> ResultReader::ReadRows()
{
    std::vector<RowSet::Row> rows;
    RowSet::Row row;
    while (ReadRow(row))
        rows.push_back(std::move(row));
    return rows;
}

ResultReader::Column ResultReader::Describe(SQLUSMALLINT number)
{
    std::array<char16_t, 256> name{};
    Column column;
    SQLSMALLINT length = 0;
    SQLULEN size = 0;
    SQLSMALLINT digits = 0;
    SQLSMALLINT isNullable = 0;
    connection.Require(odbc.DescribeColW(statement.Get(), number, OdbcText(name.data()), name.size(), &length,
                                         &column.type, &size, &digits, &isNullable),
                       statement);
    column.name = name.data();
    return column;
}

Variant ResultReader::Cell(SQLUSMALLINT number, SQLSMALLINT type)
{
    switch (type) {
    case SQL_BIT: {
        unsigned char bit = 0;
        return Get(number, SQL_C_BIT, bit) ? Variant(bit != 0) : Empty;
    }
    case SQL_TINYINT:
    case SQL_SMALLINT: {
        std::int16_t integer = 0;
        return Get(number, SQL_C_SSHORT, integer) ? Variant(integer) : Empty;
    }
    case SQL_INTEGER: {
        std::int32_t integer = 0;
        return Get(number, SQL_C_SLONG, integer) ? Variant(integer) : Empty;
    }
    case SQL_BIGINT:
    case SQL_REAL:
    case SQL_FLOAT:
    case SQL_DOUBLE:
    case SQL_NUMERIC:
    case SQL_DECIMAL: {
        double value = 0;
        return Get(number, SQL_C_DOUBLE, value) ? Variant(value) : Empty;
    }
    case SQL_TYPE_DATE:
    case SQL_TYPE_TIMESTAMP:
        return DateCell(number);
    case SQL_TYPE_TIME:
    case kTimeOfSqlServer:
        return TimeCell(number);
    default:
        return TextCell(number);
    }
}

// False for null.
template <class T>
bool ResultReader::Get(SQLUSMALLINT number, SQLSMALLINT kind, T& value)
{
    SQLLEN length = 0;
    connection.Require(odbc.GetData(statement.Get(), number, kind, &value, sizeof(value), &length), statement);
    return length != SQL_NULL_DATA;
}

Variant ResultReader::DateCell(SQLUSMALLINT number)
{
    SQL_TIMESTAMP_STRUCT moment{};
    return Get(number, SQL_C_TYPE_TIMESTAMP, moment) ? DateOf(moment) : Empty;
}

// A time of day is a date on the zero day.
Variant ResultReader::TimeCell(SQLUSMALLINT number)
{
    SQL_TIME_STRUCT time{};
    if (!Get(number, SQL_C_TYPE_TIME, time))
        return Empty;
    return Date{(time.hour * 3600.0 + time.minute * 60.0 + time.second) / kSecondsPerDay};
}

// Long texts come in pieces, each ended by a zero.
Variant ResultReader::TextCell(SQLUSMALLINT number)
{
    std::array<char16_t, 4096> piece{};
    Text text;
    while (true) {
        SQLLEN length = 0;
        const SQLRETURN result =
            odbc.GetData(statement.Get(), number, SQL_C_WCHAR, piece.data(), sizeof(piece), &length);
        connection.Require(result, statement);
        if (result == SQL_NO_DATA)
            return text;
        if (length == SQL_NULL_DATA)
            return Empty;
        const bool isCut = length == SQL_NO_TOTAL || length >= static_cast<SQLLEN>(sizeof(piece));
        text.append(piece.data(), isCut ? piece.size() - 1 : static_cast<std::size_t>(length) / sizeof(char16_t));
        if (!isCut)
            return text;
    }
}

} // namespace varnex3
