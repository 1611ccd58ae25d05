// Files where the system is Windows: files that are held, names that no file can have, long ones.
#include <cerrno>

#include <windows.h>

#include "tests/TemporaryFolder.h"
#include "tests/xml/Documents.h"
#include "tests/xml/SystemErrors.h"
#include "varnex3/xml/Folder.h"
#include "varnex3/xml/WindowsError.h"

namespace varnex3::xml {

using tests::ErrorOf;
using tests::TemporaryFolder;

namespace {

// A file that is open so that nobody else may open it.
class HeldFile
{
public:
    explicit HeldFile(const std::filesystem::path& path)
        : handle(CreateFileW(path.c_str(), GENERIC_READ, 0, nullptr, OPEN_EXISTING, 0, nullptr))
    {
        REQUIRE(handle != INVALID_HANDLE_VALUE);
    }
    ~HeldFile() { CloseHandle(handle); }
    HeldFile(const HeldFile&) = delete;
    HeldFile& operator=(const HeldFile&) = delete;

private:
    HANDLE handle;
};

bool AnyFile(std::u16string_view) { return true; }

} // namespace

TEST_CASE("A file that another program holds is not permitted, neither to read nor to replace; it stays as it was")
{
    const TemporaryFolder folder;
    folder.Write("a.xml", "old");
    {
        const HeldFile held(folder.Path("a.xml"));
        CHECK(ErrorOf([&] { ReadFile(folder.Name("a.xml")); }) == EACCES);
        CHECK(ErrorOf([&] { WriteFileAtomically(folder.Name("a.xml"), "new"); }) == EACCES);
    }
    CHECK(ReadFile(folder.Name("a.xml")) == "old");
    CHECK(folder.Names() == std::vector<std::u16string>{u"a.xml"});
}

TEST_CASE("A file that is marked as read-only is not replaced")
{
    const TemporaryFolder folder;
    folder.Write("a.xml", "old");
    REQUIRE(SetFileAttributesW(folder.Path("a.xml").c_str(), FILE_ATTRIBUTE_READONLY) != 0);
    CHECK(ErrorOf([&] { WriteFileAtomically(folder.Name("a.xml"), "new"); }) == EACCES);
    REQUIRE(SetFileAttributesW(folder.Path("a.xml").c_str(), FILE_ATTRIBUTE_NORMAL) != 0);
    CHECK(ReadFile(folder.Name("a.xml")) == "old");
    CHECK(folder.Names().size() == 1);
}

TEST_CASE("A file that is being read may be read by others, renamed and deleted meanwhile")
{
    const TemporaryFolder folder;
    folder.Write("a.xml", "abc");
    InputFile file(folder.Name("a.xml"));
    CHECK(ReadFile(folder.Name("a.xml")) == "abc");
    std::filesystem::rename(folder.Path("a.xml"), folder.Path("b.xml"));
    std::filesystem::remove(folder.Path("b.xml"));
    std::string bytes(file.Room(), '\0');
    CHECK(file.Read(bytes.data(), bytes.size()) == 3);
    CHECK(bytes.substr(0, 3) == "abc");
}

TEST_CASE("A name that no file can have is an invalid argument")
{
    const TemporaryFolder folder;
    CHECK(ErrorOf([&] { ReadFile(folder.Name() + u"\\a<b>.xml"); }) == EINVAL);
    CHECK(ErrorOf([&] { WriteFileAtomically(folder.Name() + u"\\a?.xml", "x"); }) == EINVAL);
    CHECK(folder.Names().empty());
}

TEST_CASE("Names are 16-bit text, and either slash separates them")
{
    const TemporaryFolder folder;
    const std::u16string name = u"caf\u00E9 \u65E5\u672C \U0001F600.xml";
    WriteFileAtomically(folder.Name() + u"/" + name, "<a/>");
    CHECK(ReadFile(folder.Name() + u"\\" + name) == "<a/>");
    CHECK(Folder(folder.Name()).FileNames(AnyFile) == std::vector<std::u16string>{name});
}

TEST_CASE("Paths may be longer than 260 characters: of files and of folders")
{
    const TemporaryFolder folder;
    std::u16string path = folder.Name();
    std::vector<std::filesystem::path> made;
    while (path.size() < 400) {
        path += u"\\" + std::u16string(60, u'f');
        made.emplace_back(u"\\\\?\\" + path);
        REQUIRE(CreateDirectoryW(made.back().c_str(), nullptr) != 0);
    }
    CHECK(IsFolder(path));
    WriteFileAtomically(path + u"/a.xml", "long");
    CHECK(ReadFile(path + u"/../" + std::u16string(60, u'f') + u"/./a.xml") == "long");
    CHECK(Folder(path).FileNames(AnyFile) == std::vector<std::u16string>{u"a.xml"});
    CHECK(ErrorOf([&] { ReadFile(path + u"/none.xml"); }) == ENOENT);
    CHECK(ErrorOf([&] { ReadFile(path); }) == EISDIR);
    REQUIRE(DeleteFileW((made.back() / "a.xml").c_str()) != 0);
    for (; !made.empty(); made.pop_back())
        REQUIRE(RemoveDirectoryW(made.back().c_str()) != 0);
}

TEST_CASE("A file stands behind a backslash, unless the folder ends with a separator or a drive's colon")
{
    const TemporaryFolder folder;
    CHECK(Folder(folder.Name()).PathOf(u"a.xml") == folder.Name() + u"\\a.xml");
    CHECK(Folder(folder.Name() + u"/").PathOf(u"a.xml") == folder.Name() + u"/a.xml");
    CHECK(Folder(folder.Name() + u"\\").PathOf(u"a.xml") == folder.Name() + u"\\a.xml");
    CHECK(Folder(u"C:").PathOf(u"a.xml") == u"C:a.xml"); // in that drive's current folder
}

TEST_CASE("What is no folder is none: a file, a pattern, what is not there, a computer that is not there")
{
    const TemporaryFolder folder;
    folder.Write("a.xml", "");
    for (const std::u16string& path :
         {folder.Name("a.xml"), folder.Name() + u"\\*", folder.Name("none"), std::u16string(u"\\\\nobody\\none"),
          std::u16string(), std::u16string(u"Q:\\"), folder.Name() + std::u16string(u"\0x", 2)})
        CHECK_FALSE(IsFolder(path));
    CHECK(ErrorOf([&] { Folder(folder.Name("a.xml")); }) == ENOTDIR);
    CHECK(ErrorOf([&] { Folder(folder.Name("none")); }) == ENOENT);
}

TEST_CASE(
    "The system's reasons have the numbers that they have elsewhere; one that is known nowhere else is an input error")
{
    CHECK(ErrorNumberOf(ERROR_SHARING_VIOLATION) == EACCES);
    CHECK(ErrorNumberOf(ERROR_LOCK_VIOLATION) == EACCES);
    CHECK(ErrorNumberOf(ERROR_WRITE_PROTECT) == EACCES);
    CHECK(ErrorNumberOf(ERROR_BAD_NETPATH) == ENOENT);
    CHECK(ErrorNumberOf(ERROR_INVALID_DRIVE) == ENOENT);
    CHECK(ErrorNumberOf(ERROR_DISK_FULL) == ENOSPC);
    CHECK(ErrorNumberOf(ERROR_FILENAME_EXCED_RANGE) == ENAMETOOLONG);
    CHECK(ErrorNumberOf(ERROR_CRC) == EIO);
}

} // namespace varnex3::xml
