// .reg files: what they say, and what an edit leaves as it was.
#include "varnex3/services/RegistryFile.h"

#include <random>

#include "tests/Printing.h"

using namespace varnex3;
using namespace std::string_literals;

namespace {

constexpr auto kMachine = RegistryRoot::LocalMachine;
const std::string kHead = "Windows Registry Editor Version 5.00\n\n";
const std::string kKey = kHead + "[HKEY_LOCAL_MACHINE\\SOFTWARE\\App]\n";

// The data that a value has, "none" without one; a text without the zero byte at its end.
std::string At(const RegistryFile& file, std::string_view name, std::string_view path = "SOFTWARE\\App")
{
    const std::optional<RegistryValue> value = file.Find(path, name);
    if (!value)
        return "none";
    const bool isEnded = value->type == RegistryType::Text && value->data.ends_with('\0');
    return isEnded ? value->data.substr(0, value->data.size() - 1) : value->data;
}

std::string At(const std::string& bytes, std::string_view name, std::string_view path = "SOFTWARE\\App")
{
    return At(RegistryFile(kMachine, bytes), name, path);
}

// The reason why a line below a key is damaged; empty when it is not.
std::string FaultOf(const std::string& line)
{
    const std::vector<RegistryFile::Damage> damages = RegistryFile(kMachine, kKey + line + "\n").Damages();
    return damages.empty() ? "" : std::string(damages.front().reason);
}

std::string AfterSetting(const std::string& bytes, std::string_view name, const std::string& text)
{
    RegistryFile file(kMachine, bytes);
    file.SetValue("SOFTWARE\\App", name, {RegistryType::Text, text + '\0'});
    CHECK(At(file, name) == text);
    CHECK(At(file.Bytes(), name) == text);
    return file.Bytes();
}

std::string AfterSetting(const std::string& bytes, std::string_view name, RegistryType type, const std::string& data)
{
    RegistryFile file(kMachine, bytes);
    file.SetValue("SOFTWARE\\App", name, {type, data});
    CHECK(RegistryFile(kMachine, file.Bytes()).Find("SOFTWARE\\App", name)->data == data);
    return file.Bytes();
}

std::string Wide(TextView text)
{
    std::string bytes = "\xFF\xFE";
    for (const char16_t unit : text)
        bytes += {static_cast<char>(unit & 0xFF), static_cast<char>(unit >> 8)};
    return bytes;
}

} // namespace

// ---- values

TEST_CASE("A text, a 32-bit number, bytes and bytes of a type")
{
    const RegistryFile file(kMachine, kKey
                                          + "\"Text\"=\"CrvSql\"\n"
                                            "\"Number\"=dword:00000102\n"
                                            "\"Short\"=dword:a\n"
                                            "\"Bytes\"=hex:01,Ab,0\n"
                                            "\"None\"=hex:\n"
                                            "\"Quad\"=hex(b):01,02\n");
    CHECK(file.Damages().empty());
    CHECK(file.Find("SOFTWARE\\App", "Text")->data == "CrvSql\0"s);
    CHECK(At(file, "Number") == "\2\1\0\0"s);
    CHECK(file.Find("SOFTWARE\\App", "Number")->type == RegistryType::Number32);
    CHECK(At(file, "Short") == "\x0A\0\0\0"s);
    CHECK(At(file, "Bytes") == "\x01\xAB\0"s);
    CHECK(file.Find("SOFTWARE\\App", "Bytes")->type == RegistryType::Binary);
    CHECK(At(file, "None") == "");
    CHECK(file.Find("SOFTWARE\\App", "Quad")->type == static_cast<RegistryType>(11));
}

TEST_CASE("A backslash and a quotation mark stand behind a backslash, in names and texts")
{
    CHECK(At(kKey + "\"a\\\\b\\\"c\"=\"SRV\\\\SQL \\\"x\\\" ]=;\"\n", "a\\b\"c") == "SRV\\SQL \"x\" ]=;");
}

TEST_CASE("The default value is written with an at sign")
{
    CHECK(At(kKey + "@=\"x\"\n", "") == "x");
    CHECK(AfterSetting(kKey, "", "y") == kKey + "@=\"y\"\n");
}

TEST_CASE("Upper and lower case of keys, names and words are alike")
{
    const std::string bytes = kHead + "[hkey_LOCAL_machine\\Software\\APP]\n\"KEY\"=DWORD:1\n\"Bytes\"=HEX:01\n";
    CHECK(At(bytes, "key", "software\\app") == "\1\0\0\0"s);
    CHECK(At(bytes, "bytes") == "\1");
}

TEST_CASE("Bytes go on in the next line behind a backslash")
{
    CHECK(At(kKey + "\"a\"=hex:01,\\\n  02,\\  \n\t03\n\"b\"=\"x\"\n", "a") == "\1\2\3");
    CHECK(At(kKey + "\"a\"=hex:\\\r\n  01,02\r\n", "a") == "\1\2");
}

TEST_CASE("Texts as bytes are UTF-16 in version 5, the code page in REGEDIT4")
{
    const std::string key = "[HKEY_LOCAL_MACHINE\\SOFTWARE\\App]\n";
    CHECK(At(kKey + "\"a\"=hex(1):61,00,ac,20,00,00\n", "a") == "a\xE2\x82\xAC");
    CHECK(At(kKey + "\"a\"=hex(7):61,00,00,00,62,00,00,00,00,00\n", "a") == "a\0b\0\0"s);
    CHECK(At("REGEDIT4\n" + key + "\"a\"=hex(2):25,61,00\n", "a") == "%a\0"s);
    CHECK(At("REGEDIT4\n" + key + "\"a\"=hex(2):25,61,00\n" + kKey + "\"a\"=hex(2):25,00,61,00\n", "a") == "%a");
}

TEST_CASE("Comments, blank lines and blanks around the parts of a line mean nothing")
{
    const std::string bytes = "\n; first\n" + kHead
                              + " [HKEY_LOCAL_MACHINE\\SOFTWARE\\App] ; key\n\n\t; inside\n"
                                "  \"a\" = \"x\" ; text\n\"b\"=dword:1 ; number\n\"c\"=hex:01,02 ; bytes\n";
    CHECK(RegistryFile(kMachine, bytes).Damages().empty());
    CHECK(At(bytes, "a") == "x");
    CHECK(At(bytes, "b") == "\1\0\0\0"s);
    CHECK(At(bytes, "c") == "\1\2");
}

TEST_CASE("Later lines outrank earlier ones, in a key that is repeated too")
{
    CHECK(At(kKey + "\"a\"=\"1\"\n\"A\"=\"2\"\n", "a") == "2");
    CHECK(At(kKey + "\"a\"=\"1\"\n[HKEY_LOCAL_MACHINE\\x]\n[HKEY_LOCAL_MACHINE\\software\\app]\n\"a\"=\"2\"\n", "a")
          == "2");
}

TEST_CASE("A value is deleted by a minus sign; a later line gives it back")
{
    CHECK(At(kKey + "\"a\"=\"1\"\n\"A\"=-\n", "a") == "none");
    CHECK(At(kKey + "\"a\"=-\n\"a\"=\"1\"\n", "a") == "1");
    CHECK(At(kKey + "@=\"1\"\n@=-\n", "") == "none");
}

TEST_CASE("A key is deleted with those below it; its parents and its neighbours stay")
{
    const RegistryFile file(kMachine, kHead
                                          + "[HKEY_LOCAL_MACHINE\\a\\b\\c]\n\"v\"=\"1\"\n[HKEY_LOCAL_MACHINE\\a\\bb]\n"
                                            "[-HKEY_LOCAL_MACHINE\\A\\B]\n");
    CHECK(file.HasKey("a"));
    CHECK(file.HasKey("a\\bb"));
    CHECK_FALSE(file.HasKey("a\\b"));
    CHECK_FALSE(file.HasKey("a\\b\\c"));
    CHECK(At(file, "v", "a\\b\\c") == "none");
}

TEST_CASE("A key is there with those above it; a bracket in its name is a part of it")
{
    const RegistryFile file(kMachine, kHead + "[HKEY_LOCAL_MACHINE\\a\\b]c\\]\n\"v\"=\"1\"\n");
    CHECK(file.HasKey(""));
    CHECK(file.HasKey("a"));
    CHECK(file.HasKeysBelow("a"));
    CHECK(At(file, "v", "a\\b]c") == "1");
    CHECK_FALSE(file.HasKeysBelow("a\\b]c"));
}

// ---- encodings

TEST_CASE("UTF-8 with a mark and UTF-16 with one are read, and written back as they were")
{
    const Text text = ToUtf16(kKey) + u"; \u00E9\r\n\"a\"=\"caf\u00E9 \u20AC\"\r\n";
    std::string bigEndian = Wide(text);
    for (std::size_t i = 0; i < bigEndian.size(); i += 2)
        std::swap(bigEndian[i], bigEndian[i + 1]);
    for (const std::string& bytes : {"\xEF\xBB\xBF" + ToUtf8(text), ToUtf8(text), Wide(text), bigEndian}) {
        RegistryFile file(kMachine, bytes);
        CHECK(file.Damages().empty());
        CHECK(At(file, "a") == "caf\xC3\xA9 \xE2\x82\xAC");
        CHECK(file.Bytes() == bytes);
        file.SetValue("SOFTWARE\\App", "b", {RegistryType::Text, "\xC3\xA9\0"s});
        CHECK(file.Bytes().substr(0, bytes.size()) == bytes);
        CHECK(At(file.Bytes(), "b") == "\xC3\xA9");
    }
}

TEST_CASE("A line that is not UTF-8 is damaged and stays as it is, the others are read")
{
    const std::string bytes = kKey + "\"a\"=\"caf\xE9\"\n\"b\"=\"x\"\n";
    CHECK(At(bytes, "a") == "none");
    CHECK(At(bytes, "b") == "x");
    CHECK(AfterSetting(bytes, "c", "y") == bytes + "\"c\"=\"y\"\n");
}

// ---- damage

TEST_CASE("A damaged line is passed over and told with its number, its text and the reason")
{
    const RegistryFile file(kMachine, kKey + "\"a\"=\"1\"\n\"b\"=\"x\n\"c\"=\"3\"\n");
    REQUIRE(file.Damages().size() == 1);
    CHECK(file.Damages()[0].line == 5);
    CHECK(file.Damages()[0].text == "\"b\"=\"x");
    CHECK(file.Damages()[0].reason == "the closing quotation mark is missing");
    CHECK(At(file, "a") == "1");
    CHECK(At(file, "b") == "none");
    CHECK(At(file, "c") == "3");
}

TEST_CASE("Every kind of damage has its reason")
{
    CHECK(FaultOf("name=1") == "neither a key in brackets, a value nor a comment");
    CHECK(FaultOf("[HKEY_LOCAL_MACHINE\\a") == "the closing bracket is missing");
    CHECK(FaultOf("[HKEY_LOCAL_MACHINE\\a] x") == "something else stands behind it");
    CHECK(FaultOf("[HKEY_LOCAL_MACHINE\\\\a]") == "a part of the key is empty");
    CHECK(FaultOf("[]") == "a part of the key is empty");
    CHECK(FaultOf("[HKEY_CURRENT_USER\\a]") == "the key is not below HKEY_LOCAL_MACHINE");
    CHECK(FaultOf("[-HKEY_LOCAL_MACHINE]") == "a root cannot be deleted");
    CHECK(FaultOf("\"a=\"1\"") == "the equals sign is missing");
    CHECK(FaultOf("\"a\" \"1\"") == "the equals sign is missing");
    CHECK(FaultOf("\"a") == "the closing quotation mark is missing");
    CHECK(FaultOf("\"a\\") == "the closing quotation mark is missing");
    CHECK(FaultOf("\"a\"=\"SRV\\SQL\"") == "a backslash is to be written twice");
    CHECK(FaultOf("\"a\"=\"1\"2") == "something else stands behind it");
    CHECK(FaultOf("\"a\"=1") == "the data are neither a text in quotation marks, dword: nor hex:");
    CHECK(FaultOf("\"a\"=") == "the data are neither a text in quotation marks, dword: nor hex:");
    CHECK(FaultOf("\"a\"=hex01") == "the data are neither a text in quotation marks, dword: nor hex:");
    for (const char* number : {"", "123456789", "0x1", "12 3", "-1", "g"})
        CHECK(FaultOf("\"a\"=dword:"s + number) == "dword: wants one to eight hexadecimal digits");
    for (const char* bytes : {"1,,2", ",1", "1,", "123", "1 2", "g", "1;,2,"})
        CHECK(FaultOf("\"a\"=hex:"s + bytes)
              == (bytes == "1;,2,"s ? "" : "hex: wants bytes of one or two hexadecimal digits, separated by commas"));
    CHECK(FaultOf("\"a\"=hex(x):01") == "the type in brackets is no hexadecimal number");
    CHECK(FaultOf("\"a\"=hex(1:01") == "the type in brackets is no hexadecimal number");
    CHECK(FaultOf("\"a\"=hex:01,\\") == "the backslash at the end promises another line");
    CHECK(FaultOf("\"\xE9\"=\"1\"") == "the line is not UTF-8");
}

TEST_CASE("A value that promises another line does not swallow the next value or key")
{
    const std::string bytes = kKey + "\"a\"=hex:01,\\\n\"b\"=\"2\"\n\"c\"=hex:01,\\\n[HKEY_LOCAL_MACHINE\\d]\n";
    CHECK(At(bytes, "b") == "2");
    CHECK(RegistryFile(kMachine, bytes).HasKey("d"));
    CHECK(RegistryFile(kMachine, bytes).Damages().size() == 2);
}

TEST_CASE("Values below a damaged or foreign key belong to no key, and the key alone is told")
{
    for (const char* key : {"[HKEY_LOCAL_MACHINE\\b", "[HKEY_CLASSES_ROOT\\b]", "[x]"}) {
        const RegistryFile file(kMachine, kKey + "\"a\"=\"1\"\n" + key + "\n\"a\"=\"2\"\n\"b\"=\"3\"\n");
        CHECK(At(file, "a") == "1");
        CHECK(At(file, "b") == "none");
        CHECK(file.Damages().size() == 1);
    }
}

TEST_CASE("Values above the first key, or below a deleted one, are damaged")
{
    const RegistryFile file(kMachine, kHead + "\"a\"=\"1\"\n[-HKEY_LOCAL_MACHINE\\b]\n\"a\"=\"2\"\n");
    REQUIRE(file.Damages().size() == 2);
    CHECK(file.Damages()[0].reason == "the value stands below no key");
    CHECK(file.Damages()[1].line == 5);
}

TEST_CASE("A file without its head is read, and the missing head is told")
{
    const RegistryFile file(kMachine, "; mine\n[HKEY_LOCAL_MACHINE\\a]\n\"v\"=\"1\"\n");
    CHECK(At(file, "v", "a") == "1");
    REQUIRE(file.Damages().size() == 1);
    CHECK(file.Damages()[0].line == 2);
    CHECK(file.Damages()[0].reason
          == "the file does not begin with \"Windows Registry Editor Version 5.00\" or \"REGEDIT4\"");
    CHECK(RegistryFile(kMachine, "").Damages().empty());
    CHECK(RegistryFile(kMachine, "; nothing\n\n").Damages().empty());
}

TEST_CASE("Line numbers count the lines of the file, continued values too")
{
    const RegistryFile file(kMachine, kKey + "\"a\"=hex:01,\\\n  02\n\"b\"=\"x\"\n?\n");
    REQUIRE(file.Entries().size() == 2);
    CHECK(file.Entries()[0].line == 4);
    CHECK(file.Entries()[1].line == 6);
    CHECK(file.Damages().front().line == 7);
}

TEST_CASE("Entries: the values that hold, in the order of the file, spelled as there")
{
    const RegistryFile file(kMachine, kKey + "\"B\"=\"1\"\n\"A\"=\"2\"\n\"b\"=\"3\"\n\"C\"=\"4\"\n\"c\"=-\n");
    REQUIRE(file.Entries().size() == 2);
    CHECK(file.Entries()[0].name == "A");
    CHECK(file.Entries()[1].name == "b");
    CHECK(file.Entries()[1].path == "SOFTWARE\\App");
}

TEST_CASE("No bytes make reading or an edit fail")
{
    const std::string whole =
        kKey + "\"a\\\\b\"=\"x\\\"\"\r\n@=hex(7):01,\\\r\n  02 ; c\n\"n\"=dword:1\n[-HKEY_LOCAL_MACHINE\\x]";
    const std::string marks = "\"\\[]=,;\n\r-@";
    std::mt19937 random(7);
    for (int round = 0; round < 3000; ++round) {
        std::string bytes = round % 3 == 0 ? Wide(ToUtf16(whole)) : whole;
        for (int i = 0; i < 3; ++i)
            bytes[random() % bytes.size()] = i == 0 ? static_cast<char>(random()) : marks[random() % marks.size()];
        bytes.resize(bytes.size() - random() % 20);
        RegistryFile file(kMachine, bytes);
        file.SetValue("SOFTWARE\\App", "new", {RegistryType::Text, "value\0"s});
        CHECK(At(file, "new") == "value");
    }
}

// ---- edits

TEST_CASE("A value is replaced where it stands: its name's spelling, the blanks and the comment behind it stay")
{
    CHECK(AfterSetting(kKey + "; why\n  \"Key\" = \"old\" ; what\n\"z\"=\"1\"\n", "KEY", "new")
          == kKey + "; why\n  \"Key\" = \"new\" ; what\n\"z\"=\"1\"\n");
}

TEST_CASE("Of a value that is written twice the later one is replaced")
{
    CHECK(AfterSetting(kKey + "\"a\"=\"1\"\n\"a\"=\"2\"\n", "a", "3") == kKey + "\"a\"=\"1\"\n\"a\"=\"3\"\n");
}

TEST_CASE("A new value goes behind the last value of its key, before the blank lines and comments that follow")
{
    CHECK(AfterSetting(kKey + "\"a\"=\"1\"\n\n; next\n[HKEY_LOCAL_MACHINE\\b]\n", "c", "2")
          == kKey + "\"a\"=\"1\"\n\"c\"=\"2\"\n\n; next\n[HKEY_LOCAL_MACHINE\\b]\n");
    CHECK(AfterSetting(kKey + "\n; next\n[HKEY_LOCAL_MACHINE\\b\n\"c\"=\"1\"\n", "c", "2")
          == kKey + "\"c\"=\"2\"\n\n; next\n[HKEY_LOCAL_MACHINE\\b\n\"c\"=\"1\"\n"); // not below the damaged key
}

TEST_CASE("A new value goes behind the line that deleted it, and into the key that was not deleted")
{
    CHECK(AfterSetting(kKey + "\"a\"=\"1\"\n\"a\"=-\n", "a", "2") == kKey + "\"a\"=\"1\"\n\"a\"=-\n\"a\"=\"2\"\n");
    const std::string deleted = kKey + "\"a\"=\"1\"\n[-HKEY_LOCAL_MACHINE\\SOFTWARE\\App]\n";
    CHECK(AfterSetting(deleted, "a", "2") == deleted + "\n[HKEY_LOCAL_MACHINE\\SOFTWARE\\App]\n\"a\"=\"2\"\n");
}

TEST_CASE("A new file begins with the head")
{
    CHECK(AfterSetting("", "a", "1") == kHead + "[HKEY_LOCAL_MACHINE\\SOFTWARE\\App]\n\"a\"=\"1\"\n");
}

TEST_CASE("A key that is there through one below it gets lines of its own for a value")
{
    const std::string below = kHead + "[HKEY_LOCAL_MACHINE\\SOFTWARE\\App\\Below]\n";
    CHECK(AfterSetting(below, "a", "1") == below + "\n[HKEY_LOCAL_MACHINE\\SOFTWARE\\App]\n\"a\"=\"1\"\n");
}

TEST_CASE("Line ends are those of the file; a last line without one gets one")
{
    CHECK(AfterSetting("REGEDIT4\r\n[HKEY_LOCAL_MACHINE\\SOFTWARE\\App]", "a", "1")
          == "REGEDIT4\r\n[HKEY_LOCAL_MACHINE\\SOFTWARE\\App]\r\n\"a\"=\"1\"\r\n");
    CHECK(AfterSetting(kKey + "\"a\"=\"1\"", "a", "2") == kKey + "\"a\"=\"2\"");
}

TEST_CASE("Damaged lines, foreign keys and comments survive an edit byte for byte")
{
    const std::string rest =
        "\n; caf\xC3\xA9\n?!\n\"x\"=dwrod:1\n[HKEY_CLASSES_ROOT\\y]\n\"z\"=\"1\"\n \t \n\"w\"=hex:01,\\\n";
    CHECK(AfterSetting(kKey + "\"a\"=\"1\"" + rest, "a", "2") == kKey + "\"a\"=\"2\"" + rest);
}

TEST_CASE("Numbers and bytes are written as the registry editor writes them")
{
    CHECK(AfterSetting(kKey, "a", RegistryType::Number32, "\2\1\0\0"s) == kKey + "\"a\"=dword:00000102\n");
    CHECK(AfterSetting(kKey, "a", RegistryType::Number32, "\2\1"s) == kKey + "\"a\"=hex(4):02,01\n");
    CHECK(AfterSetting(kKey, "a", RegistryType::Binary, "\xFF\0"s) == kKey + "\"a\"=hex:ff,00\n");
    CHECK(AfterSetting(kKey, "a", RegistryType::Binary, "") == kKey + "\"a\"=hex:\n");
    CHECK(AfterSetting(kKey, "a", RegistryType::TextList, "a\0\0"s) == kKey + "\"a\"=hex(7):61,00,00,00,00,00\n");
    CHECK(AfterSetting(kKey, "a", static_cast<RegistryType>(0), "\1"s) == kKey + "\"a\"=hex(0):01\n");
}

TEST_CASE("Many bytes are broken into lines of 80 characters at most, and read back")
{
    const std::string bytes = AfterSetting(kKey, "name", RegistryType::Binary, std::string(1024, 'x'));
    std::size_t longest = 0;
    for (std::size_t at = 0; at < bytes.size(); at = bytes.find('\n', at) + 1)
        longest = std::max(longest, bytes.find('\n', at) - at);
    CHECK(longest > 75);
    CHECK(longest <= 80);
    CHECK(bytes.find(",\\\n  78,") != std::string::npos);
}

TEST_CASE("A text that cannot stand between quotation marks is written as bytes, and read back")
{
    for (const std::string& text : {"a\nb"s, "a\r"s, "a\0b"s}) {
        const std::string bytes = AfterSetting(kKey, "a", text);
        CHECK(bytes.find("\"a\"=hex(1):61,00,") != std::string::npos);
        AfterSetting("REGEDIT4\n\n[HKEY_LOCAL_MACHINE\\SOFTWARE\\App]\n", "a", text);
    }
    CHECK(AfterSetting(kKey, "a", "tab\there") == kKey + "\"a\"=\"tab\there\"\n");
}

TEST_CASE("A replaced value takes its continued lines with it")
{
    CHECK(AfterSetting(kKey + "\"a\"=hex:01,\\\n  02,\\\n  03 ; c\n\"b\"=\"1\"\n", "a", "x")
          == kKey + "\"a\"=\"x\" ; c\n\"b\"=\"1\"\n");
}

TEST_CASE("A deleted key goes with its values wherever they stand; comments stay, and so does its parent")
{
    RegistryFile file(kMachine, kKey
                                    + "; c\n\"a\"=\"1\"\n[HKEY_LOCAL_MACHINE\\b]\n[HKEY_LOCAL_MACHINE\\software\\APP]\n"
                                      "\"z\"=\"2\"\n");
    file.DeleteKey("Software\\App");
    CHECK(file.Bytes() == kHead + "; c\n[HKEY_LOCAL_MACHINE\\b]\n\n[HKEY_LOCAL_MACHINE\\Software]\n");
    CHECK_FALSE(file.HasKey("SOFTWARE\\App"));
}
