// The rules of the settings, over a registry in memory.
#include "varnex3/services/ModRegistry.h"

#include "tests/Printing.h"
#include "tests/services/MemoryRegistry.h"

using namespace varnex3;
using tests::MemoryRegistry;
using Calls = std::vector<std::string>;

namespace {

constexpr auto kMachine = RegistryRoot::LocalMachine;
constexpr const char* kMachineKey = "HKLM\\SOFTWARE\\corvo32\\frmSplash";
constexpr const char* kUserKey = "HKCU\\Software\\VB and VBA Program Settings\\corvo32\\frmSplash";

Text Setting(MemoryRegistry& registry, const Text& sDefault, bool bNoMigrate)
{
    return GetAppSetting(u"corvo32", u"frmSplash", u"Key", sDefault, bNoMigrate, registry);
}

// What a value of some bytes reads as.
Text Read(RegistryType type, const std::string& data)
{
    MemoryRegistry registry;
    registry.Put("HKLM\\k", "v", type, data);
    return QueryRegValue(kMachine, u"k", u"v", registry);
}

// The bytes of a 32-bit number after a text was written to it.
std::string Number32(TextView sValue)
{
    MemoryRegistry registry;
    registry.Put("HKLM\\k", "v", RegistryType::Number32, std::string("\7\7\7\7"));
    CHECK(SetRegValue(kMachine, u"k", u"v", sValue, registry));
    CHECK(registry.OpenHandles() == 0);
    return registry.At("HKLM\\k", "v");
}

std::string Bytes(int a, int b, int c, int d)
{
    return {static_cast<char>(a), static_cast<char>(b), static_cast<char>(c), static_cast<char>(d)};
}

} // namespace

// ---- GetAppSetting

TEST_CASE("GetAppSetting: a machine-wide value is returned, and the user's store is not looked at")
{
    MemoryRegistry registry;
    registry.PutText(kMachineKey, "Key", "M");
    registry.PutText(kUserKey, "Key", "U");
    CHECK(Setting(registry, u"D", false) == u"M");
    CHECK(registry.calls == Calls{"open HKLM\\SOFTWARE\\corvo32\\frmSplash", "query Key", "close"});
}

TEST_CASE("GetAppSetting: without a machine-wide value, the user's is returned and written machine-wide")
{
    MemoryRegistry registry;
    registry.PutText(kUserKey, "Key", "X");
    CHECK(Setting(registry, u"D", false) == u"X");
    CHECK(registry.At(kMachineKey, "Key") == "X");
    CHECK(registry.OpenHandles() == 0);
}

TEST_CASE("GetAppSetting: the user's value stays where it is after migration")
{
    MemoryRegistry registry;
    registry.PutText(kUserKey, "Key", "X");
    Setting(registry, u"", false);
    CHECK(registry.At(kUserKey, "Key") == std::string("X\0", 2));
}

TEST_CASE("GetAppSetting: with neither, the default is returned and written machine-wide")
{
    MemoryRegistry registry;
    CHECK(Setting(registry, u"0", false) == u"0");
    CHECK(registry.At(kMachineKey, "Key") == "0");
}

TEST_CASE("GetAppSetting: bNoMigrate writes, creates and deletes nothing")
{
    MemoryRegistry registry;
    CHECK(Setting(registry, u"0", true) == u"0");
    registry.PutText(kUserKey, "Key", "X");
    CHECK(Setting(registry, u"0", true) == u"X");
    for (const std::string& call : registry.calls)
        CHECK((call.starts_with("open ") || call.starts_with("query ") || call == "close"));
}

TEST_CASE("GetAppSetting: an empty result is not migrated")
{
    MemoryRegistry registry;
    CHECK(Setting(registry, u"", false) == u"");
    CHECK(registry.keys.empty());
}

TEST_CASE("GetAppSetting: an empty machine-wide value counts as none")
{
    MemoryRegistry registry;
    registry.PutText(kMachineKey, "Key", "");
    CHECK(Setting(registry, u"D", true) == u"D");
}

TEST_CASE("GetAppSetting: a user's value that is there but empty is no reason for the default")
{
    MemoryRegistry registry;
    registry.PutText(kUserKey, "Key", "");
    CHECK(Setting(registry, u"D", false) == u"");
    CHECK(registry.At(kMachineKey, "Key") == "none");
}

TEST_CASE("GetAppSetting: a user's value that is no text counts as none")
{
    MemoryRegistry registry;
    registry.Put(kUserKey, "Key", RegistryType::Number32, Bytes(1, 0, 0, 0));
    CHECK(Setting(registry, u"D", true) == u"D");
}

TEST_CASE("GetAppSetting: a user's text may be longer than the buffer")
{
    MemoryRegistry registry;
    registry.PutText(kUserKey, "Key", std::string(5000, 'x'));
    CHECK(Setting(registry, u"D", true) == Text(5000, u'x'));
}

TEST_CASE("GetAppSetting: migration sets, creates the key when that failed and sets again, then deletes")
{
    MemoryRegistry registry;
    Setting(registry, u"D", false);
    CHECK(registry.calls
          == Calls{"open HKLM\\SOFTWARE\\corvo32\\frmSplash",
                   "open HKCU\\Software\\VB and VBA Program Settings\\corvo32\\frmSplash",
                   "open HKLM\\SOFTWARE\\corvo32\\frmSplash", "close invalid", // set
                   "create HKLM\\SOFTWARE\\corvo32\\frmSplash", "close",       // create
                   "open HKLM\\SOFTWARE\\corvo32\\frmSplash", "query Key", "set Key", "close",
                   "delete HKCU\\SOFTWARE\\corvo32\\frmSplash\\Key\\"});
}

TEST_CASE("GetAppSetting: a key that is there is not created")
{
    MemoryRegistry registry;
    registry.PutText(kMachineKey, "Other", "");
    Setting(registry, u"D", false);
    CHECK(std::ranges::count(registry.calls, "create HKLM\\SOFTWARE\\corvo32\\frmSplash") == 0);
    CHECK(registry.At(kMachineKey, "Key") == "D");
}

TEST_CASE("GetAppSetting: migration without the right to write fails silently")
{
    MemoryRegistry registry;
    registry.canCreate = false;
    CHECK(Setting(registry, u"D", false) == u"D");
    CHECK(registry.At(kMachineKey, "Key") == "none");

    registry.PutText(kMachineKey, "Other", "");
    registry.readOnly = {tests::Folded(kMachineKey)};
    CHECK(Setting(registry, u"D", false) == u"D");
    CHECK(registry.At(kMachineKey, "Key") == "none");
    CHECK(registry.OpenHandles() == 0);
}

TEST_CASE("GetAppSetting: application, section and key are addressed as they are given")
{
    MemoryRegistry registry;
    registry.PutText("HKLM\\SOFTWARE\\Microsoft\\Windows NT\\CurrentVersion", "CurrentVersion", "6.1");
    CHECK(GetAppSetting(u"Microsoft", u"Windows NT\\CurrentVersion", u"CurrentVersion", u"", false, registry)
          == u"6.1");
}

// ---- QueryRegValue

TEST_CASE("QueryRegValue: a text, with or without the zero byte at its end")
{
    CHECK(Read(RegistryType::Text, std::string("abc\0", 4)) == u"abc");
    CHECK(Read(RegistryType::Text, "abc") == u"abc");
    CHECK(Read(RegistryType::Text, std::string("abc\0\0", 5)) == Text(u"abc\0", 4)); // one zero byte is cut
    CHECK(Read(RegistryType::Text, ToCodePage(u"caf\u00E9")) == Text(u"caf\u00E9"));
}

TEST_CASE("QueryRegValue: a missing key or value is the empty text, and no key stays open")
{
    MemoryRegistry registry;
    CHECK(QueryRegValue(kMachine, u"k", u"v", registry) == u"");
    registry.PutText("HKLM\\k", "other", "x");
    CHECK(QueryRegValue(kMachine, u"k", u"v", registry) == u"");
    CHECK(registry.OpenHandles() == 0);
}

TEST_CASE("QueryRegValue: an existing but empty text is the empty text")
{
    CHECK(Read(RegistryType::Text, std::string("\0", 1)) == u"");
    CHECK(Read(RegistryType::Text, "") == u"");
}

TEST_CASE("QueryRegValue: a value without data leaves its key open")
{
    MemoryRegistry registry;
    registry.Put("HKLM\\k", "v", RegistryType::Text, "");
    CHECK(QueryRegValue(kMachine, u"k", u"v", registry) == u"");
    CHECK(registry.OpenHandles() == 1);
    QueryRegValue(kMachine, u"k", u"v", registry);
    CHECK(registry.OpenHandles() == 2);
    registry.PutText("HKLM\\k", "v", "");
    QueryRegValue(kMachine, u"k", u"v", registry);
    CHECK(registry.OpenHandles() == 2); // one zero byte is data
}

TEST_CASE("QueryRegValue: 1024 bytes can be read, 1025 cannot")
{
    CHECK(Read(RegistryType::Text, std::string(1024, 'x')) == Text(1024, u'x'));
    CHECK(Read(RegistryType::Text, std::string(1023, 'x') + '\0') == Text(1023, u'x'));
    CHECK(Read(RegistryType::Text, std::string(1024, 'x') + '\0') == u"");
}

TEST_CASE("QueryRegValue: the buffer's size counts bytes, not characters")
{
    const Text accents(1024 / ToCodePage(u"\u00E9").size(), u'\u00E9'); // two bytes each where the code page is UTF-8
    CHECK(Read(RegistryType::Text, ToCodePage(accents)) == accents);
    CHECK(Read(RegistryType::Text, ToCodePage(accents) + "e") == u"");
}

TEST_CASE("QueryRegValue: a 32-bit number is read from its bytes' hexadecimal digits without leading zeros")
{
    CHECK(Read(RegistryType::Number32, Bytes(2, 1, 0, 0)) == u"18"); // 258: "0", "1", "2"
    CHECK(Read(RegistryType::Number32, Bytes(0, 0, 0, 0)) == u"0");
    CHECK(Read(RegistryType::Number32, Bytes(1, 0, 0, 0)) == u"1");
    CHECK(Read(RegistryType::Number32, Bytes(5, 0, 0, 0)) == u"5");
    CHECK(Read(RegistryType::Number32, Bytes(0, 1, 0, 0)) == u"16"); // 256: "0", "1", "0"
    CHECK(Read(RegistryType::Number32, Bytes(0xFF, 0, 0, 0)) == u"255");
    CHECK(Read(RegistryType::Number32, Bytes(0x10, 0x20, 0, 0)) == u"8208"); // two digits each: as it is
    CHECK(Read(RegistryType::Number32, Bytes(0, 0, 0, 1)) == u"4096");       // 16777216: "1", "0", "0", "0"
    CHECK(Read(RegistryType::Number32, Bytes(0xFF, 0xFF, 0xFF, 0xFF)) == u"4294967295");
    CHECK(Read(RegistryType::Number32, Bytes(0x0A, 0, 0, 0x0B)) == u"45066"); // "b", "0", "0", "a"
}

TEST_CASE("QueryRegValue: a number of another size than four bytes is read the same way, as far as 64 bits go")
{
    CHECK(Read(RegistryType::Number32, Bytes(2, 1, 0, 0).substr(0, 2)) == u"18");
    CHECK(Read(RegistryType::Number32, std::string("\0", 1)) == u""); // no byte is left
    CHECK(Read(RegistryType::Number32, std::string(8, '\xFF')) == u"18446744073709551615");
    CHECK(Read(RegistryType::Number32, std::string(9, '\xFF')) == u"");
}

TEST_CASE("QueryRegValue: any other type is the empty text")
{
    for (const auto type : {RegistryType::ExpandableText, RegistryType::Binary, RegistryType::TextList,
                            static_cast<RegistryType>(0), static_cast<RegistryType>(11)})
        CHECK(Read(type, "abc") == u"");
}

// ---- SetRegValue

TEST_CASE("SetRegValue: a key that is not there is False, and the handle that is none is closed")
{
    MemoryRegistry registry;
    CHECK_FALSE(SetRegValue(kMachine, u"k", u"v", u"x", registry));
    CHECK(registry.calls == Calls{"open HKLM\\k", "close invalid"});
}

TEST_CASE("SetRegValue: a new value is a text, written without a zero byte at its end")
{
    MemoryRegistry registry;
    registry.keys["hklm\\k"];
    CHECK(SetRegValue(kMachine, u"k", u"v", u"caf\u00E9", registry));
    CHECK(registry.At("HKLM\\k", "v") == ToCodePage(u"caf\u00E9"));
    CHECK(registry.keys["hklm\\k"]["v"].type == RegistryType::Text);
    CHECK(registry.OpenHandles() == 0);
}

TEST_CASE("SetRegValue: an empty text is written as no data")
{
    MemoryRegistry registry;
    registry.PutText("HKLM\\k", "v", "old");
    CHECK(SetRegValue(kMachine, u"k", u"v", u"", registry));
    CHECK(registry.At("HKLM\\k", "v") == "");
}

TEST_CASE("SetRegValue: a 32-bit number takes the four bytes of the text's number, lowest first")
{
    CHECK(Number32(u"258") == Bytes(2, 1, 0, 0));
    CHECK(Number32(u"0") == Bytes(0, 0, 0, 0));
    CHECK(Number32(u"4294967295") == Bytes(255, 255, 255, 255));
    CHECK(Number32(u"4294967297") == Bytes(1, 0, 0, 0)); // four bytes and no more
    CHECK(Number32(u"1e300").size() == 4);
}

TEST_CASE("SetRegValue: the number is what the text begins with, 0 when it begins with none")
{
    CHECK(Number32(u" 12 monkeys") == Bytes(12, 0, 0, 0));
    CHECK(Number32(u"1,5") == Bytes(1, 0, 0, 0));
    CHECK(Number32(u"2e1x") == Bytes(20, 0, 0, 0));
    CHECK(Number32(u"2each") == Bytes(2, 0, 0, 0));
    CHECK(Number32(u"2e+") == Bytes(2, 0, 0, 0));
    CHECK(Number32(u"+.9.9") == Bytes(1, 0, 0, 0));
    for (const TextView text : {u"", u"x1", u"-", u".", u"e5", u"&H10", u"True"})
        CHECK(Number32(text) == Bytes(0, 0, 0, 0));
}

TEST_CASE("SetRegValue: the number is rounded, halves to even")
{
    CHECK(Number32(u"1.5") == Bytes(2, 0, 0, 0));
    CHECK(Number32(u"2.5") == Bytes(2, 0, 0, 0));
    CHECK(Number32(u"2.51") == Bytes(3, 0, 0, 0));
    CHECK(Number32(u"255.5") == Bytes(0, 1, 0, 0));
}

TEST_CASE("SetRegValue: a negative number is divided towards zero, so it is no two's complement")
{
    CHECK(Number32(u"-1") == Bytes(255, 0, 0, 0));
    CHECK(Number32(u"-257") == Bytes(255, 255, 0, 0));
    CHECK(Number32(u"-0.4") == Bytes(0, 0, 0, 0));
}

TEST_CASE("SetRegValue: a number too large for any number is False, and the old value stays")
{
    MemoryRegistry registry;
    registry.Put("HKLM\\k", "v", RegistryType::Number32, Bytes(7, 0, 0, 0));
    CHECK_FALSE(SetRegValue(kMachine, u"k", u"v", u"1e999", registry));
    CHECK(registry.At("HKLM\\k", "v") == Bytes(7, 0, 0, 0));
    CHECK(registry.OpenHandles() == 0);
}

TEST_CASE("SetRegValue: a value of any other type is written back as the whole buffer it was read into")
{
    for (const auto type : {RegistryType::Binary, RegistryType::ExpandableText, static_cast<RegistryType>(0)}) {
        MemoryRegistry registry;
        registry.Put("HKLM\\k", "v", type, "abc");
        CHECK(SetRegValue(kMachine, u"k", u"v", u"new", registry));
        CHECK(registry.At("HKLM\\k", "v") == "abc" + std::string(1021, '\0'));
        CHECK(registry.keys["hklm\\k"]["v"].type == type);
    }
}

TEST_CASE("SetRegValue: over a value longer than the buffer it is False")
{
    MemoryRegistry registry;
    registry.Put("HKLM\\k", "v", RegistryType::Text, std::string(1025, 'x'));
    CHECK_FALSE(SetRegValue(kMachine, u"k", u"v", u"new", registry));
    CHECK(registry.At("HKLM\\k", "v").size() == 1025);
    CHECK(registry.OpenHandles() == 0);
    registry.Put("HKLM\\k", "v", RegistryType::Text, std::string(1024, 'x'));
    CHECK(SetRegValue(kMachine, u"k", u"v", u"new", registry));
}

TEST_CASE("SetRegValue: a value that cannot be queried, or cannot be written, is False")
{
    MemoryRegistry registry;
    registry.PutText("HKLM\\k", "v", "x");
    registry.queryFault = RegistryStatus::AccessDenied;
    CHECK_FALSE(SetRegValue(kMachine, u"k", u"v", u"y", registry));
    registry.queryFault = RegistryStatus::Done;
    registry.readOnly = {"hklm\\k"};
    CHECK_FALSE(SetRegValue(kMachine, u"k", u"v", u"y", registry));
    CHECK(registry.At("HKLM\\k", "v") == std::string("x\0", 2));
    CHECK(registry.OpenHandles() == 0);
}

// ---- keys

TEST_CASE("CreateRegKey: the key is created and closed again; failure is ignored")
{
    MemoryRegistry registry;
    CreateRegKey(kMachine, u"k", registry);
    CHECK(registry.keys.contains("hklm\\k"));
    CHECK(registry.OpenHandles() == 0);
    registry.canCreate = false;
    CreateRegKey(kMachine, u"l", registry);
    CHECK_FALSE(registry.keys.contains("hklm\\l"));
}

TEST_CASE("DeleteRegKey: the key is deleted; failure is ignored")
{
    MemoryRegistry registry;
    registry.keys["hkcu\\k"];
    DeleteRegKey(RegistryRoot::CurrentUser, u"k", registry);
    CHECK(registry.keys.empty());
    DeleteRegKey(RegistryRoot::CurrentUser, u"k", registry);
    CHECK(registry.calls == Calls{"delete HKCU\\k", "delete HKCU\\k"});
}
