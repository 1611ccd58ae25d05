#include "varnex3/services/DatabaseConnection.h"

#include <array>

namespace varnex3 {

namespace {

// Attributes that are numbers travel as pointers.
SQLPOINTER AsPointer(std::chrono::seconds limit)
{
    return reinterpret_cast<SQLPOINTER>(limit.count()); // NOLINT(performance-no-int-to-ptr): the interface is so
}

const OdbcFunctions& RequiredOdbc()
{
    if (const OdbcFunctions* const odbc = Odbc())
        return *odbc;
    throw Error(kConnectionFailed, {}, u"there is no ODBC driver manager");
}

// Whether a failure leaves the connection of no use: it broke, or an answer that is still on its way was given up.
bool IsBreak(TextView state) { return state.starts_with(u"08") || state == u"HYT00" || state == u"HYT01"; }

} // namespace

DatabaseConnection::DatabaseConnection()
    : odbc(RequiredOdbc()),
      environment(odbc, SQL_HANDLE_ENV, SQL_NULL_HANDLE),
      connection(odbc, SQL_HANDLE_DBC, environment.Get())
{}

DatabaseConnection::~DatabaseConnection()
{
    if (isOpened)
        odbc.Disconnect(connection.Get());
}

void DatabaseConnection::Open(const Text& connectionString, std::chrono::seconds loginTimeout)
{
    odbc.SetConnectAttrW(connection.Get(), SQL_ATTR_LOGIN_TIMEOUT, AsPointer(loginTimeout), SQL_IS_UINTEGER);
    const SQLRETURN result = odbc.DriverConnectW(connection.Get(), nullptr, OdbcText(connectionString.c_str()), SQL_NTS,
                                                 nullptr, 0, nullptr, SQL_DRIVER_NOPROMPT);
    if (!SQL_SUCCEEDED(result))
        throw Error(kConnectionFailed, {}, DescriptionOf(Diagnose(odbc, connection)));
    isOpened = true;

    std::array<char16_t, 128> product{};
    SQLSMALLINT length = 0;
    odbc.GetInfoW(connection.Get(), SQL_DBMS_NAME, product.data(), sizeof(product), &length);
    serverProduct = product.data();
}

bool DatabaseConnection::IsOpen() const
{
    if (!isOpened || isBroken)
        return false;
    SQLUINTEGER isDead = SQL_CD_FALSE;
    odbc.GetConnectAttrW(connection.Get(), SQL_ATTR_CONNECTION_DEAD, &isDead, SQL_IS_UINTEGER, nullptr);
    return isDead == SQL_CD_FALSE;
}

std::unique_ptr<OdbcHandle> DatabaseConnection::NewStatement() const
{
    auto statement = std::make_unique<OdbcHandle>(odbc, static_cast<SQLSMALLINT>(SQL_HANDLE_STMT), connection.Get());
    odbc.SetStmtAttrW(statement->Get(), SQL_ATTR_QUERY_TIMEOUT, AsPointer(commandTimeout), SQL_IS_UINTEGER);
    return statement; // a driver that knows no such limit has none
}

void DatabaseConnection::Require(SQLRETURN result, const OdbcHandle& statement)
{
    if (SQL_SUCCEEDED(result) || result == SQL_NO_DATA)
        return;
    const OdbcDiagnosis diagnosis = Diagnose(odbc, statement);
    isBroken = isBroken || IsBreak(diagnosis.state);
    throw Error(kCallFailed, {}, DescriptionOf(diagnosis));
}

} // namespace varnex3
