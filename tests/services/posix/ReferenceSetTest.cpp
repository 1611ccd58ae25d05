// Reference sets that are asked for again and again while there is no database.
#include <thread>

#include "tests/Printing.h"
#include "tests/services/DatabaseServers.h"

using namespace varnex3;
using namespace std::chrono_literals;
using tests::Called;
using tests::DatabaseFolder;
using tests::TdsServer;

namespace {

std::size_t RowsOfSet() { return GetReferenceSet(u"REPAIRMODELTYPE", u"")->Count(); }

// A set that finds nothing, and then a database that is there.
struct DatabaseThatComes
{
    DatabaseFolder folder;
    TdsServer server{folder};

    DatabaseThatComes()
    {
        folder.Use({{"ServerName", "127.0.0.1,1"}});
        CHECK(RowsOfSet() == 0);
        folder.UsePort(server.Port());
    }
};

} // namespace

TEST_CASE("Where a set found no database, the next sets do not look for one; a second later they do")
{
    const DatabaseThatComes database;
    for (int i = 0; i < 100; ++i)
        CHECK(RowsOfSet() == 0);
    CHECK(database.server.Count("login") == 0);
    std::this_thread::sleep_for(1100ms);
    CHECK(RowsOfSet() == 3);
}

TEST_CASE("DBConnect and DBExecSP end the pause of the sets at once")
{
    {
        const DatabaseThatComes database;
        CHECK(DBConnect());
        CHECK(RowsOfSet() == 3);
    }
    const DatabaseThatComes database;
    CHECK(Called(u"rowSet").lID == 42);
    CHECK(RowsOfSet() == 3);
}

TEST_CASE("The pause of the sets is that of their thread")
{
    const DatabaseThatComes database;
    std::size_t rows = 0;
    std::thread([&] { rows = RowsOfSet(); }).join();
    CHECK(rows == 3);
    CHECK(RowsOfSet() == 0);
}

TEST_CASE("A set that the database does not have is no reason for a pause")
{
    const DatabaseFolder folder;
    const TdsServer server(folder);
    folder.UsePort(server.Port());
    CHECK(GetReferenceSet(u"NOSUCHSET", u"")->Count() == 0);
    CHECK(RowsOfSet() == 3);
}
