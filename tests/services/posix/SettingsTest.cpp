// Where the settings are, and what the tools tell about them.
#include "varnex3/services/Settings.h"

#include "tests/Printing.h"
#include "tests/services/Folder.h"
#include "varnex3/services/ModRegistry.h"

using namespace varnex3;
using namespace std::string_literals;
using tests::RaisedBy;
using tests::SettingsFolder;

namespace {

constexpr auto kMachine = RegistryRoot::LocalMachine;
constexpr auto kUser = RegistryRoot::CurrentUser;

// A variable of the environment that is as it was afterwards.
class Variable
{
public:
    Variable(const char* name_, const char* value) : name(name_)
    {
        if (const char* const before = std::getenv(name))
            old = before;
        if (value != nullptr)
            setenv(name, value, 1);
        else
            unsetenv(name);
    }
    ~Variable() { old.empty() ? unsetenv(name) : setenv(name, old.c_str(), 1); }
    Variable(const Variable&) = delete;
    Variable& operator=(const Variable&) = delete;

private:
    const char* name;
    std::string old;
};

} // namespace

TEST_CASE("The machine's settings are in /etc, the user's in the folder of the user's settings")
{
    const Variable folder("VARNEX3_SETTINGS_DIR", nullptr);
    const Variable home("HOME", "/home/ann");
    CHECK(SettingsPath(kMachine) == u"/etc/varnex3/machine.reg");
    {
        const Variable config("XDG_CONFIG_HOME", "/home/ann/conf");
        CHECK(SettingsPath(kUser) == u"/home/ann/conf/varnex3/user.reg");
    }
    for (const char* notAbsolute : {"", "conf", static_cast<const char*>(nullptr)}) {
        const Variable config("XDG_CONFIG_HOME", notAbsolute);
        CHECK(SettingsPath(kUser) == u"/home/ann/.config/varnex3/user.reg");
    }
}

TEST_CASE("One variable moves both files; empty, it moves none")
{
    const Variable folder("VARNEX3_SETTINGS_DIR", "/srv/caf\xE9");
    CHECK(SettingsPath(kMachine) == Text(u"/srv/caf\xDCE9/machine.reg"));
    CHECK(SettingsPath(kUser) == Text(u"/srv/caf\xDCE9/user.reg"));
    const Variable none("VARNEX3_SETTINGS_DIR", "");
    CHECK(SettingsPath(kMachine) == u"/etc/varnex3/machine.reg");
}

TEST_CASE("Without a home folder there are no settings of the user, and none can be written")
{
    const Variable folder("VARNEX3_SETTINGS_DIR", nullptr);
    const Variable config("XDG_CONFIG_HOME", nullptr);
    const Variable home("HOME", nullptr);
    CHECK(SettingsPath(kUser) == u"");
    CHECK_FALSE(ReadSettings(kUser).isThere);
    CHECK(QueryRegValue(kUser, u"k", u"v") == u"");
    CreateRegKey(kUser, u"k");
    CHECK_FALSE(SetRegValue(kUser, u"k", u"v", u"x"));
}

TEST_CASE("A file that is not there is told so")
{
    const SettingsFolder folder;
    const SettingsContent content = ReadSettings(kMachine);
    CHECK_FALSE(content.isThere);
    CHECK(content.path == ToUtf16(folder.Path()) + u"/machine.reg");
    CHECK(content.settings.empty());
}

TEST_CASE("Settings are told with their key, name, data, type and line")
{
    const SettingsFolder folder;
    folder.Write("user.reg", "REGEDIT4\n[HKEY_CURRENT_USER\\Software\\App]\n\"Name\"=\"a \\\\ b\"\n@=dword:5\n"
                             "\"List\"=hex(7):61,00,00\n");
    const SettingsContent content = ReadSettings(kUser);
    CHECK(content.isThere);
    REQUIRE(content.settings.size() == 3);
    CHECK(content.settings[0].key == u"Software\\App");
    CHECK(content.settings[0].name == u"Name");
    CHECK(content.settings[0].display == u"a \\ b");
    CHECK(content.settings[0].type == RegistryType::Text);
    CHECK(content.settings[0].line == 3);
    CHECK(content.settings[1].name == u"");
    CHECK(content.settings[1].display == u"dword:00000005");
    CHECK(content.settings[2].display == u"hex(7):61,00,00");
    CHECK(content.damagedLines.empty());
}

TEST_CASE("Damaged lines are told with their number, their text and the reason")
{
    const SettingsFolder folder;
    folder.Write("machine.reg", "REGEDIT4\r\n[HKEY_LOCAL_MACHINE\\App]\r\n\"Server\"=\"SRV\\SQL\"\r\n\"b\"=\"2\"\r\n");
    const SettingsContent content = ReadSettings(kMachine);
    CHECK(content.settings.size() == 1);
    REQUIRE(content.damagedLines.size() == 1);
    CHECK(content.damagedLines[0].number == 3);
    CHECK(content.damagedLines[0].line == u"\"Server\"=\"SRV\\SQL\"");
    CHECK(content.damagedLines[0].reason == u"a backslash is to be written twice");
}

TEST_CASE("A file that cannot be read raises the system's reason")
{
    const SettingsFolder folder;
    std::filesystem::create_directory(folder.Path() + "/machine.reg");
    CHECK(RaisedBy([] { ReadSettings(kMachine); }) == "75 Settings.Read");
}
