// Whole files in and out, and the names that files have.
#include <cerrno>
#include <filesystem>

#include "Documents.h"
#include "tests/TemporaryFolder.h"
#include "tests/xml/SystemErrors.h"

namespace varnex3::xml {

using tests::ErrorOf;
using tests::TemporaryFolder;

TEST_CASE("A file is written and read back, over an old one too")
{
    const TemporaryFolder folder;
    WriteFileAtomically(folder.Name("a.xml"), "first, and longer");
    CHECK(ReadFile(folder.Name("a.xml")) == "first, and longer");
    WriteFileAtomically(folder.Name("a.xml"), std::string_view("se\0cond", 7));
    CHECK(ReadFile(folder.Name("a.xml")) == std::string("se\0cond", 7));
    WriteFileAtomically(folder.Name("a.xml"), "");
    CHECK(ReadFile(folder.Name("a.xml")) == "");
}

TEST_CASE("Writing leaves the file alone in its folder, no temporary one beside it")
{
    const TemporaryFolder folder;
    WriteFileAtomically(folder.Name("a.xml"), "x");
    CHECK(folder.Names() == std::vector<std::u16string>{u"a.xml"});
}

TEST_CASE("A file that cannot be replaced stays, and nothing is left behind")
{
    const TemporaryFolder folder;
    std::filesystem::create_directory(folder.Path("a.xml")); // is in the way
    CHECK(ErrorOf([&] { WriteFileAtomically(folder.Name("a.xml"), "x"); }) == EISDIR);
    CHECK(folder.Names() == std::vector<std::u16string>{u"a.xml"});
}

TEST_CASE("Writing into a folder that is not there fails by the file's name")
{
    const TemporaryFolder folder;
    CHECK(ErrorOf([&] { WriteFileAtomically(folder.Name("none/a.xml"), "x"); }) == ENOENT);
    CHECK_THROWS_WITH_AS(WriteFileAtomically(u"/none/a.xml", "x"), doctest::Contains("/none/a.xml"), std::system_error);
}

TEST_CASE("A name without folder is in the current one")
{
    const TemporaryFolder folder;
    const std::filesystem::path before = std::filesystem::current_path();
    std::filesystem::current_path(folder.Path());
    WriteFileAtomically(u"a.xml", "x");
    CHECK(ReadFile(u"a.xml") == "x");
    std::filesystem::current_path(before);
    CHECK(folder.Names() == std::vector<std::u16string>{u"a.xml"});
}

TEST_CASE("A file that cannot be read fails with the system's reason and its name")
{
    const TemporaryFolder folder;
    CHECK(ErrorOf([&] { ReadFile(folder.Name("none.xml")); }) == ENOENT);
    CHECK(ErrorOf([&] { ReadFile(folder.Name()); }) == EISDIR);
    CHECK(ErrorOf([] { ReadFile(u""); }) == ENOENT);
    CHECK_THROWS_WITH_AS(ReadFile(u"/none.xml"), doctest::Contains("/none.xml"), std::system_error);
}

TEST_CASE("A name with a zero character is no file")
{
    const std::u16string name = std::u16string(u"/dev/null") + u'\0' + u"x";
    CHECK(ErrorOf([&] { ReadFile(name); }) == EINVAL);
    CHECK(ErrorOf([&] { WriteFileAtomically(name, "x"); }) == EINVAL);
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

TEST_CASE("A document is loaded from a file in any of its encodings")
{
    const TemporaryFolder folder;
    WriteFileAtomically(folder.Name("8.xml"), "\xEF\xBB\xBF<a>\xE2\x82\xAC</a>");
    WriteFileAtomically(folder.Name("16.xml"), std::string_view("\xFF\xFE<\0a\0>\0\xAC\x20<\0/\0a\0>\0", 18));
    WriteFileAtomically(folder.Name("1252.xml"), "<?xml version='1.0' encoding='windows-1252'?><a>\x80</a>");
    for (const char16_t* name : {u"8.xml", u"16.xml", u"1252.xml"}) {
        Document document;
        CHECK(document.LoadFile(folder.Name(name)));
        CHECK(document.Root().Text() == u"\u20AC");
    }
}

TEST_CASE("A file that is not well-formed has its error; one that is not there leaves the document empty")
{
    const TemporaryFolder folder;
    WriteFileAtomically(folder.Name("a.xml"), "<a>&amp;\r\n</b>");
    Document document;
    CHECK_FALSE(document.LoadFile(folder.Name("a.xml")));
    CHECK(document.Error().code == ErrorCode::TagMismatch);
    CHECK(document.Error().line == 2);
    CHECK(document.Error().column == 3);

    CHECK(document.LoadText(u"<a/>"));
    CHECK(ErrorOf([&] { document.LoadFile(folder.Name("none.xml")); }) == ENOENT);
    CHECK_FALSE(document.Root());
    CHECK(document.Error().code == ErrorCode::NoRootElement);
}

TEST_CASE("A document is saved as UTF-8, and its declaration says so")
{
    const TemporaryFolder folder;
    const std::u16string path = folder.Name("a.xml");
    Loaded(u"<?xml version='1.0' encoding='UTF-16' standalone='yes'?><a><b>\u20AC</b></a>").SaveFile(path);
    CHECK(
        ReadFile(path)
        == "<?xml version=\"1.0\" encoding=\"UTF-8\" standalone=\"yes\"?>\r\n<a>\r\n\t<b>\xE2\x82\xAC</b>\r\n</a>\r\n");
    LoadedBytes("<a>\xE2\x82\xAC</a>").SaveFile(path);
    CHECK(ReadFile(path) == "<a>\xE2\x82\xAC</a>\r\n");
}

TEST_CASE("A saved document loads to the same document")
{
    const TemporaryFolder folder;
    const Document first = LoadedBytes("<?xml version='1.0' encoding='windows-1252'?><a b='\x80'>\x93x\x94 &#9;</a>");
    first.SaveFile(folder.Name("a.xml"));
    Document second;
    CHECK(second.LoadFile(folder.Name("a.xml")));
    CHECK(second.Xml() == first.Xml());
    CHECK(second.Root().Text() == u"\u201Cx\u201D \t");
}

TEST_CASE("A document that cannot be saved raises the system's reason")
{
    CHECK(ErrorOf([] { Loaded(u"<a/>").SaveFile(u"/none/a.xml"); }) == ENOENT);
}

} // namespace varnex3::xml
