// The workshop's database through the driver manager of Windows.
#include "tests/Printing.h"
#include "varnex3/services/ModRegistry.h"
#include "varnex3/services/Odbc.h"
#include "varnex3/services/modDBAccess.h"

using namespace varnex3;

namespace {

std::string Failure(TextView procedure)
{
    std::int32_t lID = -1;
    try {
        DBExecSP(procedure, u"", lID, false, false);
    } catch (const Error& error) {
        return std::to_string(error.Number()) + " " + std::to_string(lID) + " " + ToUtf8(error.Description());
    }
    return "none";
}

} // namespace

TEST_CASE("A library without the functions of a driver manager is none")
{
    OdbcFunctions functions;
    CHECK_FALSE(LoadOdbc("no-such-library.dll", functions));
    CHECK_FALSE(LoadOdbc("kernel32.dll", functions));
    CHECK(Odbc() != nullptr); // every Windows has one
}

TEST_CASE("Without a database there is none, and no error; the reason is told")
{
    CHECK_FALSE(DBConnect());
    REQUIRE(LastConnectFailure());
    CHECK(LastConnectFailure()->reason != u"");
    std::int32_t lID = -1;
    CHECK(DBExecSP(u"rowSet", u"", lID, false, false) == nullptr);
    CHECK(lID == -1);
    CHECK_FALSE(GetReferenceSet(u"REPAIRMODELTYPE", u"")->IsOpen());
}

TEST_CASE("[server] a reference set, outputs and failures" * doctest::skip()) // run with a server by run_with_server.py
{
    CreateRegKey(RegistryRoot::LocalMachine, u"SOFTWARE\\corvo32\\frmsplash");
    CHECK(SetRegValue(RegistryRoot::LocalMachine, u"SOFTWARE\\corvo32\\frmsplash", u"SAPwd", u"x"));
    const bool isConnected = DBConnect();
    DeleteRegKey(RegistryRoot::LocalMachine, u"SOFTWARE\\corvo32\\frmsplash");
    CHECK(isConnected);
    INFO(ToUtf8(LastConnectFailure() ? LastConnectFailure()->reason : u""));
    auto set = GetReferenceSet(u"REPAIRMODELTYPE", u"");
    REQUIRE(set->Count() == 3);
    set->Find(u"Code = 'cp'");
    CHECK(ToText(set->Field(u"Description")) == u"Allocated");
    CHECK(GetReferenceSet(u"REPAIRMODELTYPE", u"T")->Count() == 1);

    std::int32_t lID = -1;
    CHECK(DBExecSP(u"rowSet", u"", lID, false, false)->Count() > 0);
    CHECK(lID == 42);
    CHECK(Failure(u"rowSetLargeID") == "6 -1 '2147483648' is outside the range of a 32-bit integer");
}
