// Which database the settings lead to.
#include "varnex3/services/ConnectionSettings.h"

#include "tests/Printing.h"
#include "tests/services/MemoryRegistry.h"

using namespace varnex3;
using tests::MemoryRegistry;

namespace {

const std::string kPlace = "HKLM\\SOFTWARE\\corvo32\\frmsplash";

ConnectionSettings Read(const std::vector<std::pair<std::string, std::string>>& values)
{
    MemoryRegistry registry;
    for (const auto& [name, value] : values)
        registry.PutText(kPlace, name, value);
    return ReadConnectionSettings(registry);
}

Text Composed(TextView server, TextView instance)
{
    return ComposeConnectionString({u"secret", u"CrvSql", Text(server), Text(instance)});
}

} // namespace

TEST_CASE("Without settings the database is CrvSql on this computer, by the older driver")
{
    CHECK(ComposeConnectionString(Read({})) == u"Driver={SQL Server};Server=(local)\\;Database=CrvSql;Uid=sa;Pwd=;");
}

TEST_CASE("TabletUseMaster chooses the place and tells of a tablet")
{
    const std::vector<std::pair<std::string, std::string>> both{{"SAPwd", "p"},
                                                                {"DatabaseName", "d"},
                                                                {"ServerName", "s"},
                                                                {"InstanceName", "i"},
                                                                {"TabletMasterSAPwd", "P"},
                                                                {"TabletMasterDatabaseName", "D"},
                                                                {"TabletMasterServerName", "S"},
                                                                {"TabletMasterInstanceName", "I"}};
    struct Expected
    {
        const char* useMaster;
        const char16_t* composed;
        bool isTablet;
    };
    constexpr TextView plain = u"Driver={SQL Server};Server=s\\i;Database=d;Uid=sa;Pwd=p;";
    constexpr TextView master = u"Driver={SQL Server};Server=S\\I;Database=D;Uid=sa;Pwd=P;";
    for (const Expected& expected :
         {Expected{"", plain.data(), false}, Expected{"0", plain.data(), true}, Expected{"1", master.data(), false},
          Expected{"2", plain.data(), false}, Expected{"True", plain.data(), false}}) {
        auto values = both;
        values.emplace_back("TabletUseMaster", expected.useMaster);
        CHECK(ComposeConnectionString(Read(values)) == expected.composed);
        CHECK(Read(values).isTablet == expected.isTablet);
    }
}

TEST_CASE("The keys of the tablet's master have defaults of their own")
{
    CHECK(ComposeConnectionString(Read({{"TabletUseMaster", "1"}, {"ServerName", "s"}, {"SAPwd", "p"}}))
          == u"Driver={SQL Server};Server=(local)\\;Database=CrvSql;Uid=sa;Pwd=;");
}

TEST_CASE("This computer's name becomes (local), in the same letter case only")
{
    const std::string name = ToUtf8(GetLocalComputerName());
    REQUIRE_FALSE(name.empty());
    CHECK(Read({{"ServerName", name}}).serverName == u"(local)");
    std::string other = name;
    for (char& c : other)
        c = static_cast<char>(c >= 'a' && c <= 'z' ? c - 32 : c >= 'A' && c <= 'Z' ? c + 32 : c);
    if (other != name)
        CHECK(Read({{"ServerName", other}}).serverName == ToUtf16(other));
}

TEST_CASE("A backslash stands between server and instance, also without an instance")
{
    CHECK(Composed(u"SRV", u"SQLEXPRESS")
          == u"Driver={SQL Server};Server=SRV\\SQLEXPRESS;Database=CrvSql;Uid=sa;Pwd=secret;");
    CHECK(Composed(u"SRV", u"") == u"Driver={SQL Server};Server=SRV\\;Database=CrvSql;Uid=sa;Pwd=secret;");
    CHECK(Composed(u"SRV\\", u"X") == u"Driver={SQL Server};Server=SRV\\X;Database=CrvSql;Uid=sa;Pwd=secret;");
}

TEST_CASE("The newer driver is chosen by the system's version, compared as text, or by the setting")
{
    CHECK(ChoosesNewerDriver(u"6.0", u"0"));
    CHECK(ChoosesNewerDriver(u"6.1", u"0"));
    CHECK_FALSE(ChoosesNewerDriver(u"5.1", u"0"));
    CHECK_FALSE(ChoosesNewerDriver(u"10.0", u"0"));
    CHECK_FALSE(ChoosesNewerDriver(u"6", u"0"));
    CHECK_FALSE(ChoosesNewerDriver(u"", u"0"));
    CHECK(ChoosesNewerDriver(u"", u"1"));
    CHECK_FALSE(ChoosesNewerDriver(u"", u"True"));
    CHECK(DriverName(Read({{"UseNativeClient", "1"}})) == u"SQL Native Client");
}

TEST_CASE("The version is read where the system keeps it")
{
    MemoryRegistry registry;
    registry.PutText("HKLM\\SOFTWARE\\Microsoft\\Windows NT\\CurrentVersion", "CurrentVersion", "6.1");
    CHECK(ReadConnectionSettings(registry).usesNewerDriver);
}

TEST_CASE("Only UseNativeClient is written where it is not set")
{
    MemoryRegistry registry;
    ReadConnectionSettings(registry);
    CHECK(registry.At(kPlace, "UseNativeClient")
          == std::string("0\0", 2).substr(0, registry.At(kPlace, "UseNativeClient").size()));
    CHECK(registry.At(kPlace, "DatabaseName") == "none");
    CHECK(registry.At(kPlace, "SAPwd") == "none");
}
