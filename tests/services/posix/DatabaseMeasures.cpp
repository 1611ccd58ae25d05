// How long databases that are not there are waited for, and what many connections leave behind. Skipped unless asked
// for: tests/database/measure_failures runs them and shows the figures.
#include <algorithm>
#include <iostream>

#include "tests/services/DatabaseServers.h"
#include "varnex3/services/ConnectionSettings.h"

using namespace varnex3;
using tests::Called;
using tests::DatabaseFolder;
using tests::TdsDatabase;
using tests::TdsServer;

namespace {

using Settings = std::vector<std::pair<std::string, std::string>>;
using Milliseconds = std::chrono::duration<double, std::milli>;

Milliseconds TimeOfCall(bool reconnects)
{
    const auto start = std::chrono::steady_clock::now();
    CHECK(Called(u"getVarnexReferenceSet", u"REPAIRMODELTYPE\t", reconnects).rowSet == nullptr);
    return std::chrono::steady_clock::now() - start;
}

// The first attempt, and the median of the next ones as every new record makes them.
void Show(const DatabaseFolder& folder, const std::string& situation, const Settings& settings)
{
    folder.Use(settings);
    const Milliseconds first = TimeOfCall(true);
    std::vector<double> next;
    for (int i = 0; i < 21; ++i)
        next.push_back(TimeOfCall(false).count());
    std::ranges::nth_element(next, next.begin() + 10);
    printf("%-52s %10.2f %10.3f  %s\n", situation.c_str(), first.count(), next[10],
           ToUtf8(LastConnectFailure()->reason).c_str());
}

// A figure of this process in kB, such as VmRSS.
long StatusOf(const std::string& name)
{
    std::ifstream status("/proc/self/status");
    for (std::string line; std::getline(status, line);)
        if (line.starts_with(name + ":"))
            return std::stol(line.substr(name.size() + 1));
    return 0;
}

std::ptrdiff_t OpenFiles()
{
    const std::filesystem::directory_iterator open("/proc/self/fd");
    return std::distance(begin(open), end(open));
}

} // namespace

TEST_CASE("[measure] failures" * doctest::skip())
{
    const DatabaseFolder folder;
    const TdsServer silent(folder, {"--silent-login"});
    printf("%-52s %10s %10s  %s\n", "situation (ms)", "first", "next", "reason");
    Show(folder, "nothing configured, nobody at (local)", {});
    Show(folder, "driver's library missing", {{"UseNativeClient", "1"}});
    Show(folder, "port refused", {{"ServerName", "127.0.0.1,1"}});
    Show(folder, "named instance, no browser", {{"InstanceName", "SQLEXPRESS"}});
    Show(folder, "accepts and stays silent", {{"ServerName", "127.0.0.1," + std::to_string(silent.Port())}});
    if (std::getenv("VARNEX3_BLACK_HOLE") == nullptr)
        return;
    Show(folder, "black-holed address", {{"ServerName", "10.9.0.9"}});
    Show(folder, "named instance at a black-holed address", {{"ServerName", "10.9.0.9"}, {"InstanceName", "X"}});
    Show(folder, "host name, black-holed name server", {{"ServerName", "sql.example"}});
}

TEST_CASE("[measure] ten thousand connections" * doctest::skip())
{
    const TdsDatabase database;
    for (int i = 0; i <= 10000; ++i) {
        CHECK(Called(u"rowSet", u"", true).lID == 42);
        if (i == 100 || i % 2500 == 0)
            printf("after %5d connect, call and drop: %zd files, VmRSS %ld kB\n", i, OpenFiles(), StatusOf("VmRSS"));
    }
}
