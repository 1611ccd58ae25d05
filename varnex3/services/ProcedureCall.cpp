#include "varnex3/services/ProcedureCall.h"

#include <algorithm>
#include <array>
#include <limits>
#include <optional>
#include <utility>

#include "varnex3/core/Conversions.h"
#include "varnex3/core/modFunctions.h"
#include "varnex3/services/ResultReader.h"

namespace varnex3 {

namespace {

constexpr std::size_t kOutputRoom = 4000; // the longest text that is not of unlimited size
constexpr SQLULEN kLongestSizedText = 4000;

// What asks for the procedure's default. FreeTDS cannot ask for it; it sends null instead.
#ifdef _WIN32
constexpr SQLLEN kNoValue = SQL_DEFAULT_PARAM;
#else
constexpr SQLLEN kNoValue = SQL_NULL_DATA;
#endif

// The columns of a parameter list that matter here, by position: drivers do not agree on their names.
enum ListColumn : std::size_t
{
    Owner = 1,
    Procedure = 2,
    Column = 3,
    Direction = 4,
    DataType = 5,
    TypeName = 6,
    Size = 7
};

struct ProcedureName
{
    Text catalog;
    Text owner;
    Text name;
};

TextView WithoutBrackets(TextView part)
{
    const bool isBracketed = part.size() >= 2 && part.front() == u'[' && part.back() == u']';
    return isBracketed ? part.substr(1, part.size() - 2) : part;
}

// Takes what stands behind the last full stop.
Text TakeLastPart(TextView& rest)
{
    const std::size_t stop = rest.rfind(u'.');
    const TextView part = stop == TextView::npos ? rest : rest.substr(stop + 1);
    rest = stop == TextView::npos ? TextView() : rest.substr(0, stop);
    return Text(WithoutBrackets(part));
}

// u"CrvSql.dbo.getJob" and u"[dbo].[getJob]" taken apart.
ProcedureName NameFrom(TextView text)
{
    ProcedureName parts;
    parts.name = TakeLastPart(text);
    parts.owner = TakeLastPart(text);
    parts.catalog = TakeLastPart(text);
    return parts;
}

SQLWCHAR* OrNothing(const Text& text) { return text.empty() ? nullptr : OdbcText(text.c_str()); }

ParameterDirection DirectionOf(std::int16_t columnType)
{
    switch (columnType) {
    case SQL_PARAM_INPUT_OUTPUT:
        return ParameterDirection::InputOutput;
    case SQL_PARAM_OUTPUT:
        return ParameterDirection::Output;
    case SQL_RETURN_VALUE:
        return ParameterDirection::ReturnValue;
    default:
        return ParameterDirection::Input;
    }
}

// Texts of unlimited size are told with the size 0 by some drivers.
std::int64_t SizeFrom(const Variant& told)
{
    const double size = ToDouble(told);
    return size <= 0 || size >= static_cast<double>(kUnlimitedSize) ? kUnlimitedSize : static_cast<std::int64_t>(size);
}

ProcedureParameter ParameterFrom(const RowSet::Row& row)
{
    ProcedureParameter parameter;
    parameter.name = ToText(row[Column]);
    parameter.direction = DirectionOf(ToInt16(row[Direction]));
    parameter.type = DatabaseTypeOf(ToInt16(row[DataType]), ToText(row[TypeName]));
    parameter.size = SizeFrom(row[Size]);
    return parameter;
}

// SQL Server tells the name with the number of its version: "getJob;1".
bool IsAbout(const RowSet::Row& row, TextView procedure)
{
    const Text told = ToText(row[Procedure]);
    return EqualsIgnoringCase(TextView(told).substr(0, told.find(u';')), procedure);
}

bool IsWholeNumber(DatabaseType type)
{
    using enum DatabaseType;
    constexpr std::array whole{SmallInt,    Integer, TinyInt,        UnsignedTinyInt, UnsignedSmallInt,
                               UnsignedInt, BigInt,  UnsignedBigInt, Boolean};
    return std::ranges::find(whole, type) != whole.end();
}

Variant WholeNumber(std::int64_t number)
{
    const bool isNarrow =
        number >= std::numeric_limits<std::int32_t>::min() && number <= std::numeric_limits<std::int32_t>::max();
    return isNarrow ? Variant(static_cast<std::int32_t>(number)) : Variant(static_cast<double>(number));
}

bool IsOutput(const ProcedureParameter& parameter) { return parameter.direction != ParameterDirection::Input; }

} // namespace

// Where the driver finds the value of a parameter and leaves what comes back, and as what it takes them. Values travel
// by their own kind, not by the declared type: the server converts.
struct ProcedureCall::Slot
{
    ProcedureParameter* parameter;
    SQLLEN length = SQL_NULL_DATA;
    SQLBIGINT whole = 0;
    double fraction = 0;
    unsigned char bit = 0;
    Text text;

    SQLSMALLINT kind = SQL_C_WCHAR;
    SQLSMALLINT type = SQL_WVARCHAR;
    SQLULEN size = 1;
    SQLPOINTER data = nullptr;
    SQLLEN room = 0;

    explicit Slot(ProcedureParameter& parameter_) : parameter(&parameter_)
    {
        if (IsOutput(*parameter))
            MakeRoom(parameter->type);
        else
            std::visit([this](const auto& value) { Put(value); }, parameter->value);
    }

    void Use(SQLSMALLINT kind_, SQLSMALLINT type_, void* place)
    {
        kind = kind_;
        type = type_;
        data = place;
        length = 0;
    }

    void Put(EmptyValue)
    {
        length = kNoValue;
        data = &text; // any place
    }
    void Put(bool value)
    {
        bit = value ? 1 : 0;
        Use(SQL_C_BIT, SQL_BIT, &bit);
    }
    void Put(std::int32_t value)
    {
        whole = value;
        Use(SQL_C_SBIGINT, SQL_INTEGER, &whole);
        size = 10;
    }
    void Put(std::int16_t value) { Put(std::int32_t{value}); }
    void Put(double value)
    {
        fraction = value;
        Use(SQL_C_DOUBLE, SQL_DOUBLE, &fraction);
        size = 15;
    }
    void Put(Date value) { Put(FormatDate(value, 1)); } // the drivers' own form is wrong for years before 1582
    void Put(const Text& value)
    {
        text = value;
        size = std::max<SQLULEN>(text.size(), 1);
        Use(SQL_C_WCHAR, size > kLongestSizedText ? SQL_WLONGVARCHAR : SQL_WVARCHAR, text.data());
        length = static_cast<SQLLEN>(text.size() * sizeof(char16_t));
        room = length;
    }
    void Put(const Ref<Record>&) {} // no text converts to one

    void MakeRoom(DatabaseType declared)
    {
        if (IsWholeNumber(declared)) {
            Use(SQL_C_SBIGINT, SQL_BIGINT, &whole);
            size = 19;
        } else {
            text.resize(kOutputRoom + 1);
            size = kOutputRoom;
            Use(SQL_C_WCHAR, SQL_WVARCHAR, text.data());
            room = static_cast<SQLLEN>(text.size() * sizeof(char16_t));
        }
        length = SQL_NULL_DATA;
    }

    void TakeOutput() const
    {
        if (IsOutput(*parameter))
            parameter->value = Value();
    }

    Variant Value() const
    {
        if (length == SQL_NULL_DATA)
            return Empty;
        if (kind == SQL_C_SBIGINT)
            return WholeNumber(whole);
        const bool isCut = length == SQL_NO_TOTAL || length > room;
        return text.substr(0, isCut ? kOutputRoom : static_cast<std::size_t>(length) / sizeof(char16_t));
    }
};

ProcedureCall::ProcedureCall(DatabaseConnection& connection_, TextView name_) : connection(connection_), name(name_)
{
    const ProcedureName parts = NameFrom(name);
    const auto statement = connection.NewStatement();
    connection.Require(connection.Functions().ProcedureColumnsW(statement->Get(), OrNothing(parts.catalog), SQL_NTS,
                                                                OrNothing(parts.owner), SQL_NTS,
                                                                OdbcText(parts.name.c_str()), SQL_NTS, nullptr, 0),
                       *statement);
    ResultReader list(connection, *statement);
    std::optional<Text> owner;
    for (RowSet::Row row; list.ReadRow(row);) {
        if (!IsAbout(row, parts.name)) // the name is a pattern: others may match it, too
            continue;
        if (!owner)
            owner = ToText(row[Owner]);
        if (*owner == ToText(row[Owner]))
            parameters.push_back(ParameterFrom(row));
    }
}

void ProcedureCall::GiveTexts(const std::vector<TextView>& texts)
{
    std::size_t i = 0;
    for (ProcedureParameter& parameter : parameters) {
        if (parameter.direction != ParameterDirection::Input || i >= texts.size())
            continue;
        try {
            parameter.value = ConvertedText(texts[i++], parameter.type, parameter.size);
        } catch (const Error& error) {
            throw error.About({}, name + u": " + parameter.name);
        }
    }
}

std::shared_ptr<RowSet> ProcedureCall::Execute(RowSet::Form form)
{
    const auto statement = connection.NewStatement();
    std::vector<Slot> slots(parameters.begin(), parameters.end()); // the driver keeps their addresses
    Bind(*statement, slots);
    const Text text = CallText();
    connection.Require(connection.Functions().ExecDirectW(statement->Get(), OdbcText(text.c_str()), SQL_NTS),
                       *statement);
    auto rowSet = ReadResults(*statement, form);
    if (!hasOutputs)
        for (const Slot& slot : slots) // filled only now
            slot.TakeOutput();
    return rowSet;
}

const ProcedureParameter& ProcedureCall::Parameter(TextView parameter) const
{
    const auto found = std::ranges::find_if(
        parameters, [&](const ProcedureParameter& each) { return EqualsIgnoringCase(each.name, parameter); });
    if (found == parameters.end())
        throw Error(kItemNotFound, {}, name + u" has no parameter " + Quoted(parameter));
    return *found;
}

// u"{?=CALL getJob(?,?)}".
Text ProcedureCall::CallText() const
{
    const bool hasReturnValue = !parameters.empty() && parameters.front().direction == ParameterDirection::ReturnValue;
    const std::size_t count = parameters.size() - (hasReturnValue ? 1 : 0);
    Text text = hasReturnValue ? u"{?=CALL " : u"{CALL ";
    text += name;
    for (std::size_t i = 0; i < count; ++i)
        text += i == 0 ? u"(?" : u",?";
    return text + (count > 0 ? u")}" : u"}");
}

void ProcedureCall::Bind(const OdbcHandle& statement, std::vector<Slot>& slots)
{
    constexpr std::array<SQLSMALLINT, 5> kinds{0, SQL_PARAM_INPUT, SQL_PARAM_OUTPUT, SQL_PARAM_INPUT_OUTPUT,
                                               SQL_PARAM_OUTPUT};
    SQLUSMALLINT number = 0;
    for (Slot& slot : slots) {
        const SQLSMALLINT direction = kinds.at(static_cast<std::size_t>(slot.parameter->direction));
        connection.Require(connection.Functions().BindParameter(statement.Get(), ++number, direction, slot.kind,
                                                                slot.type, slot.size, 0, slot.data, slot.room,
                                                                &slot.length),
                           statement);
    }
}

// Everything is read, for an error may stand behind the rows.
std::shared_ptr<RowSet> ProcedureCall::ReadResults(const OdbcHandle& statement, RowSet::Form form)
{
    auto rowSet = std::make_shared<RowSet>();
    SQLRETURN result = SQL_SUCCESS;
    do {
        ResultReader reader(connection, statement);
        if (reader.IsRowSet()) {
            std::vector<Text> columns = reader.ColumnNames();
            std::vector<RowSet::Row> rows = reader.ReadRows();
            if (!TakeOutputsOfMariaDB(columns, rows) && !rowSet->IsOpen())
                rowSet = std::make_shared<RowSet>(std::move(columns), std::move(rows), form);
        }
        result = connection.Functions().MoreResults(statement.Get());
        connection.Require(result, statement);
    } while (result != SQL_NO_DATA);
    return rowSet;
}

// The driver of MariaDB gives the outputs as one more row set, named as they are, and leaves other things in their
// places. Whether this was that row set.
bool ProcedureCall::TakeOutputsOfMariaDB(const std::vector<Text>& columns, const std::vector<RowSet::Row>& rows)
{
    if (connection.ServerProduct() != u"MariaDB" || rows.size() != 1)
        return false;
    std::vector<ProcedureParameter*> outputs;
    for (ProcedureParameter& parameter : parameters)
        if (IsOutput(parameter))
            outputs.push_back(&parameter);
    const auto isNamed = [](const Text& column, const ProcedureParameter* output) { return column == output->name; };
    if (!std::ranges::equal(columns, outputs, isNamed))
        return false;
    for (std::size_t i = 0; i < outputs.size(); ++i)
        outputs[i]->value = rows.front()[i];
    return hasOutputs = true;
}

} // namespace varnex3
