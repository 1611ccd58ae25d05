// Databases that cannot be reached or break: nothing hangs, and what comes next is tried.
#include <tuple>

#include <arpa/inet.h>
#include <netinet/in.h>
#include <sys/socket.h>

#include "tests/Printing.h"
#include "tests/services/DatabaseServers.h"
#include "varnex3/services/DatabaseConnection.h"
#include "varnex3/services/InstanceLookup.h"

using namespace varnex3;
using namespace std::chrono_literals;
using tests::Called;
using tests::DatabaseFolder;
using tests::PassesWithDrivers;
using tests::RaisedBy;
using tests::TdsDatabase;
using tests::TdsServer;

namespace {

constexpr auto kNeverHangs = 10s; // generous: the machine may be busy
constexpr auto kNotTried = 200ms;

template <class Action>
std::chrono::steady_clock::duration Duration(Action action)
{
    const auto start = std::chrono::steady_clock::now();
    action();
    return std::chrono::steady_clock::now() - start;
}

std::string Call(TextView procedure)
{
    return RaisedBy([&] { Called called(procedure); });
}

// A port of this computer at which nobody listens.
int RefusedPort()
{
    const int listener = socket(AF_INET, SOCK_STREAM, 0);
    sockaddr_in address{};
    address.sin_family = AF_INET;
    address.sin_addr.s_addr = htonl(INADDR_LOOPBACK);
    socklen_t length = sizeof(address);
    REQUIRE(bind(listener, reinterpret_cast<sockaddr*>(&address), length) == 0);
    REQUIRE(getsockname(listener, reinterpret_cast<sockaddr*>(&address), &length) == 0);
    close(listener);
    return ntohs(address.sin_port);
}

// A port whose queue of clients is full: who comes next is not answered.
class FullPort
{
public:
    FullPort()
    {
        address.sin_family = AF_INET;
        address.sin_addr.s_addr = htonl(INADDR_LOOPBACK);
        socklen_t length = sizeof(address);
        listener = socket(AF_INET, SOCK_STREAM, 0);
        REQUIRE(bind(listener, reinterpret_cast<sockaddr*>(&address), length) == 0);
        REQUIRE(listen(listener, 0) == 0);
        REQUIRE(getsockname(listener, reinterpret_cast<sockaddr*>(&address), &length) == 0);
        for (int& client : clients) {
            client = socket(AF_INET, SOCK_STREAM | SOCK_NONBLOCK, 0);
            std::ignore = connect(client, reinterpret_cast<const sockaddr*>(&address), length);
        }
    }
    ~FullPort()
    {
        for (const int client : clients)
            close(client);
        close(listener);
    }
    FullPort(const FullPort&) = delete;
    FullPort& operator=(const FullPort&) = delete;

    int Port() const { return ntohs(address.sin_port); }

private:
    sockaddr_in address{};
    int listener = -1;
    int clients[4] = {-1, -1, -1, -1};
};

} // namespace

TEST_CASE("[child] there is no driver" * doctest::skip()) // run by the next one
{
    const DatabaseFolder folder;
    CHECK(InstalledDrivers().empty());
    CHECK_FALSE(DBConnect());
    CHECK(Called(u"rowSet").rowSet == nullptr);
    CHECK_FALSE(GetReferenceSet(u"REPAIRMODELTYPE", u"")->IsOpen());
}

TEST_CASE("Without a driver there is no database and no error")
{
    CHECK(PassesWithDrivers("[child] there is no driver", ""));
}

TEST_CASE("Without a driver manager there are no functions, and a library without them is none")
{
    OdbcFunctions functions;
    CHECK_FALSE(LoadOdbc("libno-such-manager.so.2", functions));
    CHECK_FALSE(LoadOdbc("libc.so.6", functions));
    CHECK((functions.Fetch == nullptr));
}

TEST_CASE("A driver's name whose library is missing is no connection")
{
    const DatabaseFolder folder;
    folder.Use({{"UseNativeClient", "1"}});
    CHECK_FALSE(DBConnect());
}

TEST_CASE("A refused connection ends at once, and is tried again by the next call")
{
    const DatabaseFolder folder;
    folder.UsePort(RefusedPort());
    for (int i = 0; i < 2; ++i)
        CHECK(Duration([] { CHECK_FALSE(DBConnect()); }) < kNeverHangs);
    const TdsServer server(folder);
    folder.UsePort(server.Port());
    CHECK(Called(u"rowSet").lID == 42);
}

TEST_CASE("A server that starts later is seen by the next call")
{
    const DatabaseFolder folder;
    const int port = RefusedPort();
    folder.UsePort(port);
    CHECK(Called(u"rowSet").rowSet == nullptr);
    const TdsServer server(folder, {"--port", std::to_string(port)});
    CHECK(Called(u"rowSet").lID == 42);
}

TEST_CASE("A host that is unknown is no connection")
{
    const DatabaseFolder folder;
    folder.Use({{"ServerName", "no host at all"}});
    CHECK(Duration([] { CHECK_FALSE(DBConnect()); }) < kNeverHangs);
    CHECK(LastConnectFailure()->reason == u"there is no host 'no host at all'");
}

TEST_CASE("A silent server is waited for once; then not for a while, unless the settings change or it is asked to")
{
    const DatabaseFolder folder;
    const TdsServer silent(folder, {"--silent-login"});
    folder.UsePort(silent.Port());
    CHECK(Duration([] { CHECK_FALSE(DBConnect()); }) < kNeverHangs);
    REQUIRE(LastConnectFailure()->duration > 250ms);
    CHECK(Duration([] { CHECK(Called(u"rowSet").rowSet == nullptr); }) < kNotTried);
    CHECK(silent.Count("accepted") == 1);
    CHECK(Called(u"rowSet", u"", true).rowSet == nullptr); // asked to
    CHECK(silent.Count("accepted") == 2);
    folder.UsePort(silent.Port(), "other"); // changed
    CHECK_FALSE(DBConnect());
    CHECK(silent.Count("accepted") == 3);
}

TEST_CASE("What one thread waited for in vain another one tries")
{
    const DatabaseFolder folder;
    const TdsServer silent(folder, {"--silent-login"});
    folder.UsePort(silent.Port());
    CHECK_FALSE(DBConnect());
    std::thread([] { CHECK_FALSE(DBConnect()); }).join();
    CHECK(silent.Count("accepted") == 2);
}

TEST_CASE("An address that swallows what is sent to it is waited for a short time")
{
    const DatabaseFolder folder;
    const FullPort full;
    folder.UsePort(full.Port());
    CHECK(Duration([] { CHECK_FALSE(DBConnect()); }) < kNeverHangs);
    CHECK(LastConnectFailure()->duration > 250ms);
}

TEST_CASE("A server that hangs up in a call fails the call, and the next one connects anew")
{
    const TdsDatabase database;
    for (const TextView procedure : {u"hangUpBefore", u"hangUpDuring"}) {
        const std::size_t logins = database.server.Count("login");
        Called(u"rowSet");
        CHECK(Call(procedure) == "3146 modDBAccess.DBExecSP");
        CHECK(Called(u"rowSet").lID == 42);
        CHECK(database.server.Count("login") == std::max<std::size_t>(logins, 1) + 1);
    }
}

TEST_CASE("A connection that broke while it was idle fails one call at most")
{
    const TdsDatabase database;
    CHECK(Called(u"hangUpAfter").lID == 42);
    Call(u"rowSet"); // may fail: nobody noticed
    CHECK(Called(u"rowSet").lID == 42);
    std::thread([] { const Called called(u"closeIdleConnections"); }).join();
    Call(u"rowSet");
    CHECK(Called(u"rowSet").lID == 42);
}

TEST_CASE("A server that is gone for good is no connection once that was noticed")
{
    TdsDatabase database;
    CHECK(Called(u"rowSet").lID == 42);
    database.server.Stop();
    Call(u"rowSet");
    CHECK(Called(u"rowSet").rowSet == nullptr);
}

TEST_CASE("A command that takes too long fails, and its connection is not used again")
{
    const TdsDatabase database;
    DatabaseConnection connection;
    const Text port = ToUtf16(std::to_string(database.server.Port()));
    connection.Open(u"Driver={SQL Server};Server=127.0.0.1;Port=" + port
                        + u";Database=CrvSql;Uid=sa;Pwd=x;TDS_Version=7.3;ClientCharset=UTF-8;",
                    2s);
    connection.LimitCommands(1s);
    const auto statement = connection.NewStatement();
    CHECK(Duration([&] {
              CHECK(RaisedBy([&] {
                        connection.Require(connection.Functions().ExecDirectW(
                                               statement->Get(), OdbcText(u"exec delay 60, 0, 0, ''"), SQL_NTS),
                                           *statement);
                    })
                    == "3146");
          })
          < 30s);
    CHECK_FALSE(connection.IsOpen());
}

TEST_CASE("A named instance is looked up; an unknown one and a silent browser end within the limit")
{
    const TdsDatabase database;
    const std::string port = std::to_string(database.server.Port());
    const tests::ServerProgram browser(
        database.folder.Path(), "ssrp_server.py",
        {"--instance", "SQLEXPRESS", "--tcp-port", port, "--port", "0", "--end-with-parent"});
    const auto browserPort = browser.facts.get<std::uint16_t>();
    CHECK(LookUpInstance("127.0.0.1", "sqlexpress", browserPort) == database.server.Port());
    CHECK(Duration([&] { CHECK_FALSE(LookUpInstance("127.0.0.1", "OTHER", browserPort, 300ms)); }) < kNeverHangs);
    const auto refused = static_cast<std::uint16_t>(RefusedPort());
    CHECK(Duration([&] { CHECK_FALSE(LookUpInstance("127.0.0.1", "X", refused, 60s)); }) < kNeverHangs);
}

TEST_CASE("Settings that name an instance connect to where the browser says")
{
    const TdsDatabase database;
    const std::string port = std::to_string(database.server.Port());
    database.folder.Use({{"InstanceName", "SQLEXPRESS"}, {"SAPwd", "x"}});
    CHECK_FALSE(DBConnect());
    CHECK(LastConnectFailure()->reason == u"nobody at '127.0.0.1' tells of the instance 'SQLEXPRESS'");
    const tests::ServerProgram browser(database.folder.Path(), "ssrp_server.py",
                                       {"--instance", "SQLEXPRESS", "--tcp-port", port, "--end-with-parent"});
    CHECK(Called(u"rowSet").lID == 42);
}
