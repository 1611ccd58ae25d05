// The settings in the registry of Windows itself.
#include <array>

#include <windows.h>

#include "tests/Printing.h"
#include "varnex3/services/ConnectionSettings.h"
#include "varnex3/services/ModRegistry.h"

using namespace varnex3;

namespace {

constexpr auto kMachine = RegistryRoot::LocalMachine;
constexpr auto kUser = RegistryRoot::CurrentUser;
constexpr const char* kMachineKey = "SOFTWARE\\varnex3test\\part";
constexpr const char* kUserKey = "Software\\VB and VBA Program Settings\\varnex3test\\part";
const Text kKey = u"SOFTWARE\\varnex3test\\part";

void Remove(HKEY root)
{
    RegDeleteTreeA(root, "SOFTWARE\\varnex3test");
    RegDeleteTreeA(root, "Software\\VB and VBA Program Settings\\varnex3test");
}

// Keys of a test's own, without values at first.
class ScratchKeys
{
public:
    ScratchKeys()
    {
        Clear();
        CreateRegKey(kMachine, kKey);
    }
    ~ScratchKeys() { Clear(); }
    ScratchKeys(const ScratchKeys&) = delete;
    ScratchKeys& operator=(const ScratchKeys&) = delete;

private:
    static void Clear()
    {
        Remove(HKEY_LOCAL_MACHINE);
        Remove(HKEY_CURRENT_USER);
    }
};

void Put(HKEY root, const char* key, const char* name, DWORD type, const std::string& data)
{
    REQUIRE(RegSetKeyValueA(root, key, name, type, data.data(), static_cast<DWORD>(data.size())) == ERROR_SUCCESS);
}

struct Value
{
    DWORD type = REG_NONE;
    std::string data;

    bool operator==(const Value&) const = default;
};

Value At(HKEY root, const char* key, const char* name)
{
    Value value;
    std::array<char, 2048> buffer{};
    auto size = static_cast<DWORD>(buffer.size());
    if (RegGetValueA(root, key, name, RRF_RT_ANY | RRF_NOEXPAND, &value.type, buffer.data(), &size) == ERROR_SUCCESS)
        value.data.assign(buffer.data(), size);
    return value;
}

Text Setting(const Text& sDefault, bool bNoMigrate)
{
    return GetAppSetting(u"varnex3test", u"part", u"Key", sDefault, bNoMigrate);
}

} // namespace

TEST_CASE("Registry: a text is written in the code page and read back")
{
    const ScratchKeys keys;
    CHECK(SetRegValue(kMachine, kKey, u"v", u"caf\u00E9 \u20AC"));
    CHECK(At(HKEY_LOCAL_MACHINE, kMachineKey, "v").type == REG_SZ);
    CHECK(At(HKEY_LOCAL_MACHINE, kMachineKey, "v").data.starts_with("caf\xE9 \x80"));
    CHECK(QueryRegValue(kMachine, kKey, u"v") == Text(u"caf\u00E9 \u20AC"));
    CHECK(QueryRegValue(kMachine, u"software\\VARNEX3TEST\\PART", u"V") == Text(u"caf\u00E9 \u20AC"));
}

TEST_CASE("Registry: a text of 1024 bytes with the zero byte at its end can be read, one of 1025 cannot")
{
    const ScratchKeys keys;
    Put(HKEY_LOCAL_MACHINE, kMachineKey, "fits", REG_SZ, std::string(1023, 'x') + '\0');
    Put(HKEY_LOCAL_MACHINE, kMachineKey, "long", REG_SZ, std::string(1024, 'x') + '\0');
    CHECK(QueryRegValue(kMachine, kKey, u"fits") == Text(1023, u'x'));
    CHECK(QueryRegValue(kMachine, kKey, u"long") == u"");
    CHECK_FALSE(SetRegValue(kMachine, kKey, u"long", u"y"));
}

TEST_CASE("Registry: a 32-bit number keeps its type, and is read from its bytes' hexadecimal digits")
{
    const ScratchKeys keys;
    Put(HKEY_LOCAL_MACHINE, kMachineKey, "v", REG_DWORD, std::string("\2\1\0\0", 4));
    CHECK(QueryRegValue(kMachine, kKey, u"v") == u"18");
    CHECK(SetRegValue(kMachine, kKey, u"v", u"258.5 or so"));
    CHECK(At(HKEY_LOCAL_MACHINE, kMachineKey, "v") == Value{REG_DWORD, std::string("\2\1\0\0", 4)});
}

TEST_CASE("Registry: a value of another type is written back as the whole buffer")
{
    const ScratchKeys keys;
    Put(HKEY_LOCAL_MACHINE, kMachineKey, "v", REG_BINARY, "abc");
    CHECK(QueryRegValue(kMachine, kKey, u"v") == u"");
    CHECK(SetRegValue(kMachine, kKey, u"v", u"x"));
    CHECK(At(HKEY_LOCAL_MACHINE, kMachineKey, "v") == Value{REG_BINARY, "abc" + std::string(1021, '\0')});
}

TEST_CASE("Registry: keys are created with those above them, and deleted when nothing is below them")
{
    const ScratchKeys keys;
    CreateRegKey(kUser, kKey + u"\\below");
    DeleteRegKey(kUser, kKey);
    CHECK(SetRegValue(kUser, kKey + u"\\below", u"v", u"x"));
    DeleteRegKey(kUser, kKey + u"\\below");
    CHECK_FALSE(SetRegValue(kUser, kKey + u"\\below", u"v", u"x"));
    DeleteRegKey(kUser, kKey + u"\\below"); // is ignored
}

TEST_CASE("GetAppSetting: what SaveSetting of a classic host stored is read, and written machine-wide")
{
    const ScratchKeys keys;
    CHECK(Setting(u"D", true) == u"D");
    Put(HKEY_CURRENT_USER, kUserKey, "Key", REG_SZ, std::string("U\0", 2));
    CHECK(Setting(u"D", true) == u"U");
    CHECK(QueryRegValue(kMachine, kKey, u"Key") == u"");
    CHECK(Setting(u"D", false) == u"U");
    CHECK(QueryRegValue(kMachine, kKey, u"Key") == u"U");
    CHECK(At(HKEY_CURRENT_USER, kUserKey, "Key").type == REG_SZ); // stays
}

TEST_CASE("The settings of this computer's registry lead to a database: its version chooses the newer driver")
{
    CreateRegKey(kMachine, u"SOFTWARE\\corvo32\\frmSplash");
    CHECK(SetRegValue(kMachine, u"SOFTWARE\\corvo32\\frmSplash", u"ServerName", GetLocalComputerName()));
    CHECK(GetLocalComputerName() != u"");
    const ConnectionSettings settings = ReadConnectionSettings();
    RegDeleteTreeA(HKEY_LOCAL_MACHINE, "SOFTWARE\\corvo32");
    const Text version = QueryRegValue(kMachine, u"SOFTWARE\\Microsoft\\Windows NT\\CurrentVersion", u"CurrentVersion");
    CHECK(version != u"");
    CHECK(ComposeConnectionString(settings)
          == u"Driver={" + Text(version >= u"6.0" ? u"SQL Native Client" : u"SQL Server")
                 + u"};Server=(local)\\;Database=CrvSql;Uid=sa;Pwd=;");
}
