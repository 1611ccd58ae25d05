// The same calls on a real engine of another kind, where it is installed.
#include "tests/Printing.h"
#include "tests/services/DatabaseServers.h"

using namespace varnex3;
using tests::Called;
using tests::DatabaseFolder;
using tests::RaisedBy;

namespace {

bool IsInstalled()
{
    return std::filesystem::exists("/usr/sbin/mariadbd")
           && system("ls /usr/lib/*/odbc/libmaodbc.so >/dev/null 2>&1") == 0; // NOLINT: a test's own words
}

std::string Call(TextView procedure)
{
    return RaisedBy([&] { Called called(procedure); });
}

} // namespace

TEST_CASE("[child] MariaDB" * doctest::skip()) // run by the next one
{
    const DatabaseFolder folder;
    const tests::ServerProgram server(folder.Path(), "start_mariadb", {}, std::chrono::seconds(90));
    folder.UsePort(server.facts.at("port").get<int>());

    auto set = GetReferenceSet(u"REPAIRMODELTYPE", u"");
    REQUIRE(set->Count() == 3);
    set->Find(u"Code = 'cp'");
    CHECK(ToText(set->Field(u"Description")) == u"Allocated");

    // The outputs that the driver gives as one more row set are no row set.
    const Called done(u"noRowSet");
    CHECK_FALSE(done.rowSet->IsOpen());
    CHECK(done.lID == 42);
    CHECK(Called(u"rowSet").lID == 42);
    CHECK(Called(u"rowSetNullID").lID == 0);
    CHECK(Called(u"emptyRowSet").lID == -1);
    CHECK(Called(u"noRowSetPositive").lID == 42);

    CHECK(Call(u"noRowSetFails") == "30010 modDBAccess.DBExecSP");
    CHECK(Call(u"noRowSetFailsWithNullText") == "30010 modDBAccess.DBExecSP");
    CHECK(Call(u"rowSetLargeID") == "6 modDBAccess.DBExecSP");
    CHECK(Call(u"rowSetWithoutID") == "3265 modDBAccess.DBExecSP");
    CHECK(Call(u"errorOnly") == "3146 modDBAccess.DBExecSP");
    CHECK(Call(u"noSuchProcedure") == "3146 modDBAccess.DBExecSP");

    const Called taken(u"takeIntegers", u"1\t-2\tx\t2147483647");
    CHECK(ToText(taken.rowSet->Field(u"Description")) == u"1");
    taken.rowSet->Find(u"Code = '@Big'");
    CHECK(ToText(taken.rowSet->Field(u"Description")) == u"2147483647");
}

TEST_CASE("MariaDB gives what SQL Server does")
{
    if (!IsInstalled()) {
        MESSAGE("left out: mariadb-server-core, mariadb-client-core and odbc-mariadb are not all installed");
        return;
    }
    CHECK(tests::PassesWithDrivers("[child] MariaDB", "[SQL Server]\nDriver=libmaodbc.so\n"));
}
