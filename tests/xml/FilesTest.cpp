// Whole files in and out, and the names that files have.
#include "Documents.h"

#include <cerrno>
#include <cstdlib>
#include <functional>
#include <system_error>

#include <dirent.h>
#include <sys/stat.h>
#include <unistd.h>

#include "varnex3/xml/Files.h"

namespace varnex3::xml {
namespace {

// A folder of the test's own, removed with its files at the end.
class Folder
{
public:
    Folder() { REQUIRE(mkdtemp(name.data()) != nullptr); }
    ~Folder()
    {
        for (const std::string& file : Files()) {
            unlink((name + "/" + file).c_str());
            rmdir((name + "/" + file).c_str());
        }
        rmdir(name.c_str());
    }
    Folder(const Folder&) = delete;
    Folder& operator=(const Folder&) = delete;

    std::u16string Path(std::u16string_view file) const { return ToUtf16(name) + u"/" + std::u16string(file); }
    std::string Native(std::string_view file) const { return name + "/" + std::string(file); }

    std::vector<std::string> Files() const
    {
        std::vector<std::string> files;
        DIR* folder = opendir(name.c_str());
        while (const dirent* entry = readdir(folder))
            if (std::string_view(entry->d_name) != "." && std::string_view(entry->d_name) != "..")
                files.emplace_back(entry->d_name);
        closedir(folder);
        return files;
    }

private:
    std::string name = "/tmp/varnex3-files-XXXXXX";
};

int ErrorOf(const std::function<void()>& action)
{
    try {
        action();
    } catch (const std::system_error& error) {
        return error.code().value();
    }
    return 0;
}

} // namespace

TEST_CASE("A file is written and read back, over an old one too")
{
    const Folder folder;
    WriteFileAtomically(folder.Path(u"a.xml"), "first, and longer");
    CHECK(ReadFile(folder.Path(u"a.xml")) == "first, and longer");
    WriteFileAtomically(folder.Path(u"a.xml"), std::string_view("se\0cond", 7));
    CHECK(ReadFile(folder.Path(u"a.xml")) == std::string("se\0cond", 7));
    WriteFileAtomically(folder.Path(u"a.xml"), "");
    CHECK(ReadFile(folder.Path(u"a.xml")) == "");
}

TEST_CASE("Writing leaves the file alone in its folder, no temporary one beside it")
{
    const Folder folder;
    WriteFileAtomically(folder.Path(u"a.xml"), "x");
    CHECK(folder.Files() == std::vector<std::string>{"a.xml"});
}

TEST_CASE("A file that cannot be replaced stays, and nothing is left behind")
{
    const Folder folder;
    REQUIRE(mkdir(folder.Native("a.xml").c_str(), 0777) == 0); // a folder is in the way
    CHECK(ErrorOf([&] { WriteFileAtomically(folder.Path(u"a.xml"), "x"); }) == EISDIR);
    CHECK(folder.Files() == std::vector<std::string>{"a.xml"});
}

TEST_CASE("Writing into a folder that is not there fails by the file's name")
{
    const Folder folder;
    CHECK(ErrorOf([&] { WriteFileAtomically(folder.Path(u"none/a.xml"), "x"); }) == ENOENT);
    CHECK_THROWS_WITH_AS(WriteFileAtomically(u"/none/a.xml", "x"), doctest::Contains("/none/a.xml"), std::system_error);
}

TEST_CASE("When the disk is full the old file stays")
{
    CHECK(ErrorOf([] { WriteFileAtomically(u"/dev/full", "x"); }) == ENOSPC);
    struct stat facts = {};
    REQUIRE(stat("/dev/full", &facts) == 0);
    CHECK(S_ISCHR(facts.st_mode)); // a device is written to, not replaced
}

TEST_CASE("A file keeps its permissions, a link stays a link")
{
    const Folder folder;
    WriteFileAtomically(folder.Path(u"a.xml"), "1");
    REQUIRE(chmod(folder.Native("a.xml").c_str(), 0640) == 0);
    REQUIRE(symlink("a.xml", folder.Native("link.xml").c_str()) == 0);
    WriteFileAtomically(folder.Path(u"link.xml"), "2");

    struct stat facts = {};
    REQUIRE(lstat(folder.Native("link.xml").c_str(), &facts) == 0);
    CHECK(S_ISLNK(facts.st_mode));
    REQUIRE(stat(folder.Native("a.xml").c_str(), &facts) == 0);
    CHECK((facts.st_mode & 0777) == 0640);
    CHECK(ReadFile(folder.Path(u"a.xml")) == "2");
}

TEST_CASE("A name without folder is in the current one")
{
    const Folder folder;
    char* before = getcwd(nullptr, 0);
    REQUIRE(chdir(folder.Native("").c_str()) == 0);
    WriteFileAtomically(u"a.xml", "x");
    CHECK(ReadFile(u"a.xml") == "x");
    REQUIRE(chdir(before) == 0);
    std::free(before);
    CHECK(folder.Files() == std::vector<std::string>{"a.xml"});
}

TEST_CASE("A file that cannot be read fails with the system's reason and its name")
{
    const Folder folder;
    CHECK(ErrorOf([&] { ReadFile(folder.Path(u"none.xml")); }) == ENOENT);
    CHECK(ErrorOf([&] { ReadFile(folder.Path(u"")); }) == EISDIR);
    CHECK(ErrorOf([] { ReadFile(u""); }) == ENOENT);
    CHECK_THROWS_WITH_AS(ReadFile(u"/none.xml"), doctest::Contains("/none.xml"), std::system_error);
}

TEST_CASE("A name with a zero character is no file")
{
    const std::u16string name = std::u16string(u"/dev/null") + u'\0' + u"x";
    CHECK(ErrorOf([&] { ReadFile(name); }) == EINVAL);
    CHECK(ErrorOf([&] { WriteFileAtomically(name, "x"); }) == EINVAL);
}

TEST_CASE("A file whose size the system does not tell is read to its end")
{
    CHECK(ReadFile(u"/proc/self/status").find("VmPeak") != std::string::npos);
}

TEST_CASE("Names that are UTF-8 are their text")
{
    CHECK(FromNativePath("/x/caf\xC3\xA9 \xF0\x9F\x98\x80.xml") == u"/x/caf\u00E9 \U0001F600.xml");
    CHECK(NativePath(u"/x/caf\u00E9 \U0001F600.xml") == "/x/caf\xC3\xA9 \xF0\x9F\x98\x80.xml");
}

TEST_CASE("Names that are not UTF-8 come back byte for byte")
{
    CHECK(FromNativePath("caf\xE9.xml") == std::u16string{u'c', u'a', u'f', 0xDCE9} + u".xml");
    for (const std::string& native :
         {std::string("caf\xE9.xml"), std::string("\xFF\xFE\x80"), std::string("\xC3"), std::string("\xED\xB2\x80"),
          std::string("\xED\xA0\x80\xED\xB0\x80"), std::string("\xF0\x9F\x98"), std::string("\xC0\x80")})
        CHECK(NativePath(FromNativePath(native)) == native);
}

TEST_CASE("A file with a name that is not UTF-8 is written, read and loaded by it")
{
    const Folder folder;
    const std::u16string path = FromNativePath(folder.Native("caf\xE9.xml"));
    WriteFileAtomically(path, "<a>x</a>");
    CHECK(folder.Files() == std::vector<std::string>{"caf\xE9.xml"});
    CHECK(ReadFile(path) == "<a>x</a>");
    Document document;
    CHECK(document.LoadFile(path));
}

TEST_CASE("A document is loaded from a file in any of its encodings")
{
    const Folder folder;
    WriteFileAtomically(folder.Path(u"8.xml"), "\xEF\xBB\xBF<a>\xE2\x82\xAC</a>");
    WriteFileAtomically(folder.Path(u"16.xml"), std::string_view("\xFF\xFE<\0a\0>\0\xAC\x20<\0/\0a\0>\0", 18));
    WriteFileAtomically(folder.Path(u"1252.xml"), "<?xml version='1.0' encoding='windows-1252'?><a>\x80</a>");
    for (const char16_t* name : {u"8.xml", u"16.xml", u"1252.xml"}) {
        Document document;
        CHECK(document.LoadFile(folder.Path(name)));
        CHECK(document.Root().Text() == u"\u20AC");
    }
}

TEST_CASE("A file that is not well-formed has its error; one that is not there leaves the document empty")
{
    const Folder folder;
    WriteFileAtomically(folder.Path(u"a.xml"), "<a>&amp;\r\n</b>");
    Document document;
    CHECK_FALSE(document.LoadFile(folder.Path(u"a.xml")));
    CHECK(document.Error().code == ErrorCode::TagMismatch);
    CHECK(document.Error().line == 2);
    CHECK(document.Error().column == 3);

    CHECK(document.LoadText(u"<a/>"));
    CHECK(ErrorOf([&] { document.LoadFile(folder.Path(u"none.xml")); }) == ENOENT);
    CHECK_FALSE(document.Root());
    CHECK(document.Error().code == ErrorCode::NoRootElement);
}

TEST_CASE("A document is saved as UTF-8, and its declaration says so")
{
    const Folder folder;
    const std::u16string path = folder.Path(u"a.xml");
    Loaded(u"<?xml version='1.0' encoding='UTF-16' standalone='yes'?><a><b>\u20AC</b></a>").SaveFile(path);
    CHECK(
        ReadFile(path)
        == "<?xml version=\"1.0\" encoding=\"UTF-8\" standalone=\"yes\"?>\r\n<a>\r\n\t<b>\xE2\x82\xAC</b>\r\n</a>\r\n");
    LoadedBytes("<a>\xE2\x82\xAC</a>").SaveFile(path);
    CHECK(ReadFile(path) == "<a>\xE2\x82\xAC</a>\r\n");
}

TEST_CASE("A saved document loads to the same document")
{
    const Folder folder;
    const Document first = LoadedBytes("<?xml version='1.0' encoding='windows-1252'?><a b='\x80'>\x93x\x94 &#9;</a>");
    first.SaveFile(folder.Path(u"a.xml"));
    Document second;
    CHECK(second.LoadFile(folder.Path(u"a.xml")));
    CHECK(second.Xml() == first.Xml());
    CHECK(second.Root().Text() == u"\u201Cx\u201D \t");
}

TEST_CASE("A document that cannot be saved raises the system's reason")
{
    CHECK(ErrorOf([] { Loaded(u"<a/>").SaveFile(u"/none/a.xml"); }) == ENOENT);
}

} // namespace varnex3::xml
