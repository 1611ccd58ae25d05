// The registry in files: one machine-wide, one of the user; several processes at once.
#include "varnex3/services/FileRegistry.h"

#include <array>
#include <atomic>
#include <chrono>
#include <csignal>
#include <fstream>
#include <functional>
#include <new>
#include <thread>
#include <vector>

#include <fcntl.h>
#include <sys/file.h>
#include <sys/mman.h>
#include <sys/wait.h>
#include <unistd.h>

#include "tests/Printing.h"
#include "tests/services/Folder.h"
#include "varnex3/services/ModRegistry.h"
#include "varnex3/services/Settings.h"

using namespace varnex3;
using namespace std::string_literals;
using tests::SettingsFolder;

namespace {

constexpr auto kMachine = RegistryRoot::LocalMachine;
constexpr auto kUser = RegistryRoot::CurrentUser;
const std::string kHead = "Windows Registry Editor Version 5.00\n\n";

RegistryStatus OpenStatus(RegistryRoot root, const std::string& path)
{
    RegistryKey key{};
    const RegistryStatus status = SystemRegistry().Open(root, path, key);
    CHECK((key == RegistryKey::Invalid) == (status != RegistryStatus::Done));
    SystemRegistry().Close(key);
    return status;
}

bool SetText(RegistryRoot root, TextView path, TextView name, TextView value)
{
    CreateRegKey(root, path);
    return SetRegValue(root, path, name, value);
}

// Runs what a child process does; the process ends with 0 when that is true.
pid_t Start(const std::function<bool()>& action)
{
    const pid_t child = fork();
    if (child == 0) {
        bool isGood = false;
        try {
            isGood = action();
        } catch (...) {}
        _exit(isGood ? 0 : 1);
    }
    return child;
}

bool EndedWell(pid_t child)
{
    int status = 0;
    return waitpid(child, &status, 0) == child && WIFEXITED(status) && WEXITSTATUS(status) == 0;
}

// As a user without rights, which only root can become.
bool IsTrueForNobody(const std::function<bool()>& action)
{
    return EndedWell(Start([&] { return (getuid() != 0 || setuid(65534) == 0) && action(); }));
}

bool CanBecomeNobody() { return getuid() == 0; }

// A number that parent and children share.
class SharedNumber
{
public:
    SharedNumber()
        : page(mmap(nullptr, sizeof(std::atomic<int>), PROT_READ | PROT_WRITE, MAP_SHARED | MAP_ANONYMOUS, -1, 0))
    {
        REQUIRE(page != MAP_FAILED);
        new (page) std::atomic<int>(0);
    }
    ~SharedNumber() { munmap(page, sizeof(std::atomic<int>)); }
    SharedNumber(const SharedNumber&) = delete;
    SharedNumber& operator=(const SharedNumber&) = delete;

    std::atomic<int>& operator*() const { return *static_cast<std::atomic<int>*>(page); }

private:
    void* page;
};

} // namespace

TEST_CASE("A setting written machine-wide stands in machine.reg, one of the user in user.reg")
{
    const SettingsFolder folder;
    CHECK(SetText(kMachine, u"SOFTWARE\\App\\Main", u"Server", u"SRV\\SQL"));
    CHECK(SetText(kUser, PerUserKey(u"App", u"Main"), u"Own", u"caf\u00E9"));
    CHECK(folder.Read("machine.reg")
          == kHead + "[HKEY_LOCAL_MACHINE\\SOFTWARE\\App\\Main]\n\"Server\"=\"SRV\\\\SQL\"\n");
    CHECK(folder.Read("user.reg")
          == kHead
                 + "[HKEY_CURRENT_USER\\Software\\VB and VBA Program Settings\\App\\Main]\n\"Own\"=\"caf\xC3\xA9\"\n");
    CHECK(GetAppSetting(u"app", u"MAIN", u"server", u"", true) == u"SRV\\SQL");
    CHECK(GetAppSetting(u"app", u"MAIN", u"own", u"", true) == u"caf\u00E9");
}

TEST_CASE("Migration writes the machine's file and leaves the user's as it is")
{
    const SettingsFolder folder;
    SetText(kUser, PerUserKey(u"App", u"Main"), u"Own", u"X");
    const std::string user = folder.Read("user.reg");
    CHECK(GetAppSetting(u"App", u"Main", u"Own", u"D", false) == u"X");
    CHECK(folder.Read("machine.reg") == kHead + "[HKEY_LOCAL_MACHINE\\SOFTWARE\\App\\Main]\n\"Own\"=\"X\"\n");
    CHECK(folder.Read("user.reg") == user);
    CHECK(QueryRegValue(kMachine, u"SOFTWARE\\App\\Main", u"Own") == u"X");
}

TEST_CASE("Reading makes no file, no lock and no folder")
{
    const SettingsFolder folder;
    CHECK(GetAppSetting(u"App", u"Main", u"Key", u"D", true) == u"D");
    DeleteRegKey(kUser, u"SOFTWARE\\App");
    CHECK(std::filesystem::is_empty(folder.Path()));
}

TEST_CASE("A missing folder is made with the first setting")
{
    const SettingsFolder folder;
    setenv("VARNEX3_SETTINGS_DIR", (folder.Path() + "/a/b").c_str(), 1);
    CHECK(SetText(kUser, u"k", u"v", u"x"));
    CHECK(folder.Has("a/b/user.reg"));
}

TEST_CASE("A key with a backslash at its end is the key; one with an empty part is none")
{
    const SettingsFolder folder;
    SetText(kMachine, u"SOFTWARE\\App\\", u"v", u"x");
    CHECK(QueryRegValue(kMachine, u"software\\app\\", u"V") == u"x");
    CHECK(OpenStatus(kMachine, "") == RegistryStatus::Done);
    CHECK(OpenStatus(kMachine, "SOFTWARE\\none") == RegistryStatus::NotFound);
    CHECK(OpenStatus(kMachine, "SOFTWARE\\\\App") == RegistryStatus::BadPath);
    CHECK_FALSE(SetText(kMachine, u"a\\\\b", u"v", u"x"));
}

TEST_CASE("A name that no line can hold is refused, and the file stays whole")
{
    const SettingsFolder folder;
    SetText(kMachine, u"k", u"v", u"x");
    const std::string before = folder.Read("machine.reg");
    CHECK_FALSE(SetText(kMachine, u"k", u"a\nb", u"x"));
    CHECK_FALSE(SetText(kMachine, u"k]\n[HKEY_LOCAL_MACHINE\\l", u"v", u"x"));
    CHECK(folder.Read("machine.reg") == before);
}

TEST_CASE("A text comes back as it was written, whatever is in it")
{
    const SettingsFolder folder;
    for (const Text& value : {Text(u"a\r\nb"), Text(u"\"\\\";[x]"), Text(u"a\0b", 3), Text(u" \t"), Text(u"\xD800"),
                              Text(u"\U0001F600"), Text(1023, u'x')}) {
        CHECK(SetText(kMachine, u"k", u"v", value));
        CHECK(QueryRegValue(kMachine, u"k", u"v") == value);
    }
}

TEST_CASE("A text of 1024 bytes and the zero byte at its end is longer than the buffer")
{
    const SettingsFolder folder;
    CHECK(SetText(kMachine, u"k", u"v", Text(1024, u'x')));
    CHECK(QueryRegValue(kMachine, u"k", u"v") == u"");
    CHECK_FALSE(SetRegValue(kMachine, u"k", u"v", u"y"));
}

TEST_CASE("A value keeps its type and its place in the file")
{
    const SettingsFolder folder;
    folder.Write("machine.reg",
                 kHead + "[HKEY_LOCAL_MACHINE\\k]\n; limit\n\"n\"=dword:00000005 ; rows\n\"b\"=hex:01\n");
    CHECK(SetRegValue(kMachine, u"k", u"n", u"258 rows"));
    CHECK(folder.Read("machine.reg")
          == kHead + "[HKEY_LOCAL_MACHINE\\k]\n; limit\n\"n\"=dword:00000102 ; rows\n\"b\"=hex:01\n");
    CHECK(QueryRegValue(kMachine, u"k", u"n") == u"18");
    CHECK(SetRegValue(kMachine, u"k", u"b", u"x"));
    CHECK(RegistryFile(kMachine, folder.Read("machine.reg")).Find("k", "b")->data == "\1" + std::string(1023, '\0'));
}

TEST_CASE("A key with keys below it is not deleted; without them it goes with its values")
{
    const SettingsFolder folder;
    SetText(kUser, u"a\\b", u"v", u"x");
    CHECK(SystemRegistry().Delete(kUser, "a") == RegistryStatus::AccessDenied);
    CHECK(SystemRegistry().Delete(kUser, "") == RegistryStatus::AccessDenied);
    CHECK(SystemRegistry().Delete(kUser, "A\\B\\") == RegistryStatus::Done);
    CHECK(SystemRegistry().Delete(kUser, "a\\b") == RegistryStatus::NotFound);
    CHECK(OpenStatus(kUser, "a") == RegistryStatus::Done);
    CHECK(SystemRegistry().Delete(kUser, "a") == RegistryStatus::Done);
}

TEST_CASE("A handle that was closed, or never was one, is invalid; the key of a handle may go away")
{
    const SettingsFolder folder;
    Registry& registry = SystemRegistry();
    std::array<char, 8> buffer{};
    RegistryKey key{};
    REQUIRE(registry.Create(kUser, "k", key) == RegistryStatus::Done);
    CHECK(registry.Set(key, "v", RegistryType::Text, "x") == RegistryStatus::Done);
    CHECK(registry.Query(key, "v", buffer).length == 2);
    CHECK(registry.Delete(kUser, "k") == RegistryStatus::Done);
    CHECK(registry.Set(key, "v", RegistryType::Text, "x") == RegistryStatus::KeyDeleted);
    CHECK(registry.Close(key) == RegistryStatus::Done);
    CHECK(registry.Close(key) == RegistryStatus::InvalidHandle);
    CHECK(registry.Set(key, "v", RegistryType::Text, "x") == RegistryStatus::InvalidHandle);
    CHECK(registry.Query(key, "v", buffer).status == RegistryStatus::InvalidHandle);
    CHECK(registry.Close(RegistryKey::Invalid) == RegistryStatus::InvalidHandle);
}

TEST_CASE("A key that stays open because its value has no data is open until it is closed as often")
{
    const SettingsFolder folder;
    folder.Write("machine.reg", kHead + "[HKEY_LOCAL_MACHINE\\k]\n\"v\"=hex(1):\n");
    QueryRegValue(kMachine, u"k", u"v");
    QueryRegValue(kMachine, u"k", u"v");
    RegistryKey key{};
    REQUIRE(SystemRegistry().Open(kMachine, "K", key) == RegistryStatus::Done); // the same handle again
    for (int i = 0; i < 3; ++i)
        CHECK(SystemRegistry().Close(key) == RegistryStatus::Done);
    CHECK(SystemRegistry().Close(key) == RegistryStatus::InvalidHandle);
}

TEST_CASE("A file that is changed by other means is read again, however fast, replaced or written over")
{
    const SettingsFolder folder;
    for (int i = 0; i < 400; ++i) {
        const std::string digits = std::to_string(100 + i); // the size stays
        const std::string bytes = kHead + "[HKEY_LOCAL_MACHINE\\k]\n\"v\"=\"" + digits + "\"\n";
        if (i < 100)
            folder.Write("machine.reg", bytes);
        else
            std::ofstream(folder.Path() + "/machine.reg") << bytes;
        CHECK(QueryRegValue(kMachine, u"k", u"v") == ToUtf16(digits));
    }
    std::filesystem::remove(folder.Path() + "/machine.reg");
    CHECK(QueryRegValue(kMachine, u"k", u"v") == u"");
}

TEST_CASE("A file that was left alone for seconds is read again once it is changed")
{
    const SettingsFolder folder;
    const std::string key = kHead + "[HKEY_LOCAL_MACHINE\\k]\n";
    folder.Write("machine.reg", key + "\"v\"=\"1\"\n");
    std::this_thread::sleep_for(std::chrono::milliseconds(3200));
    CHECK(QueryRegValue(kMachine, u"k", u"v") == u"1");
    CHECK(QueryRegValue(kMachine, u"k", u"v") == u"1");
    folder.Write("machine.reg", key + "\"v\"=\"2\"\n");
    CHECK(QueryRegValue(kMachine, u"k", u"v") == u"2");
}

TEST_CASE("The same value written again leaves the file untouched")
{
    const SettingsFolder folder;
    SetText(kMachine, u"k", u"v", u"x");
    struct stat before = {};
    struct stat after = {};
    REQUIRE(stat((folder.Path() + "/machine.reg").c_str(), &before) == 0);
    CHECK(SetRegValue(kMachine, u"k", u"v", u"x"));
    REQUIRE(stat((folder.Path() + "/machine.reg").c_str(), &after) == 0);
    CHECK(before.st_ino == after.st_ino);
}

// ---- rights

TEST_CASE("Reading needs the right to read alone; writing without the right is False, and migration fails silently")
{
    if (!CanBecomeNobody()) {
        MESSAGE("not root: nobody's rights are not tested");
        return;
    }
    const SettingsFolder folder;
    SetText(kMachine, u"SOFTWARE\\App\\Main", u"v", u"x");
    const std::string before = folder.Read("machine.reg");
    CHECK(IsTrueForNobody([] { return QueryRegValue(kMachine, u"SOFTWARE\\App\\Main", u"v") == u"x"; }));
    CHECK(IsTrueForNobody([] { return !SetRegValue(kMachine, u"SOFTWARE\\App\\Main", u"v", u"y"); }));
    CHECK(IsTrueForNobody([] { return GetAppSetting(u"App", u"Main", u"new", u"D", false) == u"D"; }));
    CHECK(IsTrueForNobody([] {
        RegistryKey key{};
        return SystemRegistry().Create(kMachine, "k", key) == RegistryStatus::AccessDenied
               && SystemRegistry().Delete(kMachine, "SOFTWARE\\App\\Main") == RegistryStatus::AccessDenied;
    }));
    CHECK(folder.Read("machine.reg") == before);
}

TEST_CASE("Without a file and the right to make one, the default is the result")
{
    if (!CanBecomeNobody())
        return;
    const SettingsFolder folder;
    CHECK(IsTrueForNobody([] { return GetAppSetting(u"App", u"Main", u"new", u"D", false) == u"D"; }));
    CHECK(std::filesystem::is_empty(folder.Path()));
}

TEST_CASE("A file that may not be read has no settings")
{
    if (!CanBecomeNobody())
        return;
    const SettingsFolder folder;
    SetText(kMachine, u"k", u"v", u"x");
    std::filesystem::permissions(folder.Path() + "/machine.reg", std::filesystem::perms::owner_read);
    CHECK(IsTrueForNobody([] { return QueryRegValue(kMachine, u"k", u"v").empty(); }));
    CHECK(IsTrueForNobody([] { return OpenStatus(kMachine, "k") == RegistryStatus::AccessDenied; }));
}

TEST_CASE("A folder in the file's place is no settings, and no crash")
{
    const SettingsFolder folder;
    std::filesystem::create_directory(folder.Path() + "/machine.reg");
    CHECK(QueryRegValue(kMachine, u"k", u"v") == u"");
    CHECK_FALSE(SetText(kMachine, u"k", u"v", u"x"));
}

// ---- several at once

TEST_CASE("Four processes that write at once lose nothing, and a reader never sees half a file")
{
    constexpr int kWriters = 4;
    constexpr int kUpdates = 250;
    const SettingsFolder folder;
    REQUIRE(SetText(kMachine, u"k", u"first", u"1"));
    const SharedNumber isOver;

    std::vector<pid_t> writers;
    for (int writer = 0; writer < kWriters; ++writer)
        writers.push_back(Start([writer] {
            bool isGood = true;
            for (int i = 0; i < kUpdates; ++i) {
                const Text name = ToUtf16(std::to_string(writer) + "-" + std::to_string(i));
                isGood = SetRegValue(kMachine, u"k", name, name) && isGood;
            }
            return isGood;
        }));
    const SharedNumber reads;
    std::vector<pid_t> readers;
    for (int reader = 0; reader < 2; ++reader)
        readers.push_back(Start([&] {
            std::size_t before = 1;
            bool isGood = true;
            for (; *isOver == 0;
                 ++*reads, usleep(200)) { // the whole file each time: no damage, and never fewer settings
                const SettingsContent content = ReadSettings(kMachine);
                isGood = isGood && content.damagedLines.empty() && content.settings.size() >= before
                         && QueryRegValue(kMachine, u"k", u"first") == u"1";
                before = content.settings.size();
            }
            return isGood;
        }));

    for (const pid_t writer : writers)
        CHECK(EndedWell(writer));
    *isOver = 1;
    for (const pid_t reader : readers)
        CHECK(EndedWell(reader));
    CHECK(*reads > 0);

    const RegistryFile file(kMachine, folder.Read("machine.reg"));
    CHECK(file.Entries().size() == 1 + kWriters * kUpdates);
    for (int writer = 0; writer < kWriters; ++writer)
        for (int i = 0; i < kUpdates; ++i) {
            const std::string name = std::to_string(writer) + "-" + std::to_string(i);
            const std::optional<RegistryValue> value = file.Find("k", name);
            CHECK((value && value->data == name + '\0'));
        }
    MESSAGE("reads meanwhile: ", (*reads).load());
}

TEST_CASE("Threads of one process that write at once lose nothing")
{
    const SettingsFolder folder;
    REQUIRE(SetText(kUser, u"k", u"first", u"1"));
    std::vector<std::thread> threads;
    for (int thread = 0; thread < 4; ++thread)
        threads.emplace_back([thread] {
            for (int i = 0; i < 20; ++i)
                SetRegValue(kUser, u"k", ToUtf16(std::to_string(thread) + "-" + std::to_string(i)), u"x");
        });
    for (std::thread& thread : threads)
        thread.join();
    CHECK(RegistryFile(kUser, folder.Read("user.reg")).Entries().size() == 81);
}

TEST_CASE("A process that is killed while it writes leaves a whole file and no lock behind")
{
    const SettingsFolder folder;
    REQUIRE(SetText(kMachine, u"k", u"first", u"1"));
    for (int round = 0; round < 20; ++round) {
        const pid_t writer = Start([] {
            for (int i = 0;; ++i)
                SetRegValue(kMachine, u"k", u"v", ToUtf16(std::to_string(i)));
            return true;
        });
        std::this_thread::sleep_for(std::chrono::milliseconds(3 + round));
        kill(writer, SIGKILL);
        CHECK_FALSE(EndedWell(writer));
        CHECK(ReadSettings(kMachine).damagedLines.empty());
        CHECK(QueryRegValue(kMachine, u"k", u"first") == u"1");
        CHECK(SetRegValue(kMachine, u"k", u"after", ToUtf16(std::to_string(round))));
    }
}
