#include "varnex3/services/Odbc.h"

#include <algorithm>
#include <array>

#ifndef _WIN32
#include <dlfcn.h>
#endif

namespace varnex3 {

namespace {

#ifdef _WIN32
constexpr const char* kLibrary = "odbc32.dll";

HMODULE OpenLibrary(const char* name) { return LoadLibraryA(name); }

template <class Function>
bool Find(HMODULE library, const char* name, Function& function)
{
    function = reinterpret_cast<Function>(reinterpret_cast<void*>(GetProcAddress(library, name)));
    return function != nullptr;
}
#else
constexpr const char* kLibrary = "libodbc.so.2";

void* OpenLibrary(const char* name) { return dlopen(name, RTLD_NOW | RTLD_LOCAL); }

template <class Function>
bool Find(void* library, const char* name, Function& function)
{
    function = reinterpret_cast<Function>(dlsym(library, name));
    return function != nullptr;
}
#endif

// "[FreeTDS][SQL Server]Login failed" is "Login failed".
TextView WithoutOrigin(TextView message)
{
    while (message.starts_with(u'[') && message.find(u']') != TextView::npos)
        message.remove_prefix(message.find(u']') + 1);
    return Trimmed(message);
}

bool IsInformation(const OdbcDiagnosis& diagnosis) { return diagnosis.state.starts_with(u"01"); }

// Whether there was a record of that number, counted from 1.
bool ReadRecord(const OdbcFunctions& odbc, const OdbcHandle& handle, SQLSMALLINT number, OdbcDiagnosis& diagnosis)
{
    std::array<char16_t, 6> state{};
    std::array<char16_t, SQL_MAX_MESSAGE_LENGTH> message{};
    SQLINTEGER serverNumber = 0;
    SQLSMALLINT length = 0;
    const SQLRETURN result = odbc.GetDiagRecW(handle.Kind(), handle.Get(), number, OdbcText(state.data()),
                                              &serverNumber, OdbcText(message.data()), SQL_MAX_MESSAGE_LENGTH, &length);
    if (!SQL_SUCCEEDED(result))
        return false;
    diagnosis = {state.data(), static_cast<std::int32_t>(serverNumber), Text(WithoutOrigin(message.data()))};
    return true;
}

} // namespace

bool LoadOdbc(const char* library, OdbcFunctions& functions)
{
    auto* const opened = OpenLibrary(library);
    if (opened == nullptr)
        return false;
    bool isComplete = true;
#define VARNEX_FIND(name) isComplete = Find(opened, "SQL" #name, functions.name) && isComplete;
    VARNEX_ODBC_FUNCTIONS(VARNEX_FIND)
#undef VARNEX_FIND
    return isComplete;
}

const OdbcFunctions* Odbc()
{
    static OdbcFunctions functions;
    static const bool isLoaded = LoadOdbc(kLibrary, functions);
    return isLoaded ? &functions : nullptr;
}

OdbcHandle::OdbcHandle(const OdbcFunctions& functions, SQLSMALLINT kind_, SQLHANDLE parent)
    : odbc(functions), kind(kind_)
{
    if (!SQL_SUCCEEDED(odbc.AllocHandle(kind, parent, &handle)))
        throw Error(kCallFailed, {}, u"the driver manager gives no handle");
    if (kind == SQL_HANDLE_ENV) // before anything else may be asked of it
        odbc.SetEnvAttr(handle, SQL_ATTR_ODBC_VERSION, reinterpret_cast<SQLPOINTER>(SQL_OV_ODBC3), 0);
}

OdbcHandle::~OdbcHandle() { odbc.FreeHandle(kind, handle); }

OdbcDiagnosis Diagnose(const OdbcFunctions& odbc, const OdbcHandle& handle)
{
    OdbcDiagnosis diagnosis;
    SQLSMALLINT number = 1;
    while (ReadRecord(odbc, handle, number, diagnosis) && IsInformation(diagnosis))
        ++number;
    return diagnosis;
}

Text DescriptionOf(const OdbcDiagnosis& diagnosis)
{
    if (diagnosis.state.empty())
        return u"the database driver gives no reason";
    const Text number = diagnosis.serverNumber == 0 ? Text() : u", " + ToUtf16(std::to_string(diagnosis.serverNumber));
    return diagnosis.message + u" (" + diagnosis.state + number + u")";
}

std::vector<Text> InstalledDrivers()
{
    const OdbcFunctions* const odbc = Odbc();
    std::vector<Text> names;
    if (odbc == nullptr)
        return names;
    const OdbcHandle environment(*odbc, SQL_HANDLE_ENV, SQL_NULL_HANDLE);
    std::array<char16_t, 256> name{};
    std::array<char16_t, 4096> attributes{};
    SQLSMALLINT nameLength = 0;
    SQLSMALLINT attributesLength = 0;
    SQLUSMALLINT direction = SQL_FETCH_FIRST;
    while (SQL_SUCCEEDED(odbc->DriversW(environment.Get(), direction, OdbcText(name.data()), name.size(), &nameLength,
                                        OdbcText(attributes.data()), attributes.size(), &attributesLength))) {
        names.emplace_back(name.data());
        direction = SQL_FETCH_NEXT;
    }
    return names;
}

} // namespace varnex3
