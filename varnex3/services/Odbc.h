// ODBC as this library needs it. The driver manager is loaded when a connection is first wanted, so that programs start
// and work where there is none. Only wide functions are used: texts are 16-bit Unicode in it, as they are here.
#pragma once

#include <cstdint>
#include <vector>

#ifdef _WIN32
#include <windows.h>
#endif
#include <sql.h>
#include <sqlext.h>
#include <sqlucode.h>

#include "varnex3/core/Error.h"
#include "varnex3/core/Text.h"

namespace varnex3 {

// What the database or its driver refuses, and a connection that cannot be made.
inline constexpr ErrorNumber kCallFailed{3146};
inline constexpr ErrorNumber kConnectionFailed{3151};

#define VARNEX_ODBC_FUNCTIONS(X)                                                                                       \
    X(AllocHandle)                                                                                                     \
    X(BindParameter)                                                                                                   \
    X(DescribeColW)                                                                                                    \
    X(Disconnect)                                                                                                      \
    X(DriverConnectW)                                                                                                  \
    X(DriversW)                                                                                                        \
    X(ExecDirectW)                                                                                                     \
    X(Fetch)                                                                                                           \
    X(FreeHandle)                                                                                                      \
    X(GetConnectAttrW)                                                                                                 \
    X(GetData)                                                                                                         \
    X(GetDiagRecW)                                                                                                     \
    X(GetInfoW)                                                                                                        \
    X(MoreResults)                                                                                                     \
    X(NumResultCols)                                                                                                   \
    X(ProcedureColumnsW)                                                                                               \
    X(SetConnectAttrW)                                                                                                 \
    X(SetEnvAttr)                                                                                                      \
    X(SetStmtAttrW)

// The functions of a driver manager, named as in ODBC without the SQL in front.
struct OdbcFunctions
{
#define VARNEX_DECLARE(name) decltype(&::SQL##name) name = nullptr;
    VARNEX_ODBC_FUNCTIONS(VARNEX_DECLARE)
#undef VARNEX_DECLARE
};

// The driver manager of this system; nullptr when there is none.
const OdbcFunctions* Odbc();

// Whether a library has them all. It stays loaded.
bool LoadOdbc(const char* library, OdbcFunctions& functions);

// Texts as ODBC takes and gives them; it takes them by pointers that are not const.
inline SQLWCHAR* OdbcText(const char16_t* text) { return reinterpret_cast<SQLWCHAR*>(const_cast<char16_t*>(text)); }
inline SQLWCHAR* OdbcText(char16_t* text) { return reinterpret_cast<SQLWCHAR*>(text); }

// An environment, a connection or a statement, freed at the end.
class OdbcHandle
{
public:
    OdbcHandle(const OdbcFunctions& functions, SQLSMALLINT kind_, SQLHANDLE parent);
    ~OdbcHandle();
    OdbcHandle(const OdbcHandle&) = delete;
    OdbcHandle& operator=(const OdbcHandle&) = delete;

    SQLHANDLE Get() const { return handle; }
    SQLSMALLINT Kind() const { return kind; }

private:
    const OdbcFunctions& odbc;
    SQLSMALLINT kind;
    SQLHANDLE handle = SQL_NULL_HANDLE;
};

// What went wrong with a handle: u"42000", 2812, u"Could not find stored procedure 'x'.".
struct OdbcDiagnosis
{
    Text state;
    std::int32_t serverNumber = 0;
    Text message; // without the names of those that passed it on
};

// The first failure that the handle tells; what it only informs of is left out.
OdbcDiagnosis Diagnose(const OdbcFunctions& odbc, const OdbcHandle& handle);

// u"Could not find stored procedure 'x'. (42000, 2812)".
Text DescriptionOf(const OdbcDiagnosis& diagnosis);

// The names of the drivers that are registered, as written; none without a driver manager.
std::vector<Text> InstalledDrivers();

} // namespace varnex3
