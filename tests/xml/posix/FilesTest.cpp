// Files where the system is POSIX: devices, permissions, links, names that are bytes.
#include <cerrno>

#include <sys/stat.h>
#include <unistd.h>

#include "tests/TemporaryFolder.h"
#include "tests/xml/Documents.h"
#include "tests/xml/SystemErrors.h"
#include "varnex3/xml/Files.h"

namespace varnex3::xml {

using tests::ErrorOf;
using tests::TemporaryFolder;

TEST_CASE("When the disk is full the old file stays")
{
    CHECK(ErrorOf([] { WriteFileAtomically(u"/dev/full", "x"); }) == ENOSPC);
    struct stat facts = {};
    REQUIRE(stat("/dev/full", &facts) == 0);
    CHECK(S_ISCHR(facts.st_mode)); // a device is written to, not replaced
}

TEST_CASE("A file keeps its permissions, a link stays a link")
{
    const TemporaryFolder folder;
    WriteFileAtomically(folder.Name("a.xml"), "1");
    REQUIRE(chmod(folder.Path("a.xml").c_str(), 0640) == 0);
    REQUIRE(symlink("a.xml", folder.Path("link.xml").c_str()) == 0);
    WriteFileAtomically(folder.Name("link.xml"), "2");

    struct stat facts = {};
    REQUIRE(lstat(folder.Path("link.xml").c_str(), &facts) == 0);
    CHECK(S_ISLNK(facts.st_mode));
    REQUIRE(stat(folder.Path("a.xml").c_str(), &facts) == 0);
    CHECK((facts.st_mode & 0777) == 0640);
    CHECK(ReadFile(folder.Name("a.xml")) == "2");
}

TEST_CASE("A file whose size the system does not tell is read to its end")
{
    CHECK(ReadFile(u"/proc/self/status").find("VmPeak") != std::string::npos);
}

TEST_CASE("A file with a name that is not UTF-8 is written, read and loaded by it")
{
    const TemporaryFolder folder;
    const std::u16string path = FromNativePath(folder.Path("caf\xE9.xml").native());
    WriteFileAtomically(path, "<a>x</a>");
    CHECK(folder.Names() == std::vector<std::u16string>{std::u16string(u"caf\xDCE9") + u".xml"});
    CHECK(ReadFile(path) == "<a>x</a>");
    Document document;
    CHECK(document.LoadFile(path));
}

} // namespace varnex3::xml
