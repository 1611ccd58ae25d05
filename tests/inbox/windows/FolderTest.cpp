// Scans of folders where the system is Windows.
#include <windows.h>

#include "tests/TemporaryFolder.h"
#include "tests/inbox/Scans.h"

using namespace varnex3;
using tests::Scan;
using tests::TemporaryFolder;

namespace {

DWORD OpenHandles()
{
    DWORD count = 0;
    REQUIRE(GetProcessHandleCount(GetCurrentProcess(), &count) != 0);
    return count;
}

} // namespace

TEST_CASE("A file that another program holds is 70, is named, and what was added before it stays")
{
    const TemporaryFolder inbox;
    inbox.Write("a.xml", "<Foo/>");
    inbox.Write("b.xml", "<Foo/>");
    const HANDLE held = CreateFileW(inbox.Path("b.xml").c_str(), GENERIC_READ, 0, nullptr, OPEN_EXISTING, 0, nullptr);
    REQUIRE(held != INVALID_HANDLE_VALUE);
    const auto messages = New<Xalo_Messages>();
    std::int32_t number = 0;
    Text description;
    CHECK_FALSE(messages->ParseFiles(inbox.Name(), &number, &description));
    CloseHandle(held);
    CHECK(number == 70);
    CHECK(description == u"'" + inbox.Name("b.xml") + u"': permission denied");
    CHECK(messages->Count() == 1);
}

TEST_CASE("The path of a file is the folder's as given, a backslash where needed, and the name")
{
    const TemporaryFolder inbox;
    inbox.Write("a.xml", "<Foo/>");
    const auto pathIn = [](const Text& folder) {
        const auto messages = New<Xalo_Messages>();
        CHECK(Scan(*messages, folder) == "fine");
        return messages->MessageItems(std::int32_t{0})->FilePath();
    };
    CHECK(pathIn(inbox.Name()) == inbox.Name() + u"\\a.xml");
    CHECK(pathIn(inbox.Name() + u"/") == inbox.Name() + u"/a.xml");
    CHECK(pathIn(inbox.Name() + u"\\") == inbox.Name() + u"\\a.xml");
}

TEST_CASE("What is no folder is 30030")
{
    const TemporaryFolder inbox;
    inbox.Write("a.xml", "");
    for (const Text& path :
         {inbox.Name("a.xml"), inbox.Name("none"), inbox.Name() + u"\\*.xml", Text(u"Q:\\inbox"), Text(u"a|b"), Text()})
        CHECK(Scan(*New<Xalo_Messages>(), path) == "30030");
}

TEST_CASE("No file stays open, whatever a scan meets")
{
    const TemporaryFolder inbox;
    inbox.Write("a.xml", "<Foo/>");
    inbox.Write("b.xml", "<Foo>");
    const auto messages = New<Xalo_Messages>();
    CHECK(Scan(*messages, inbox.Name()) == "fine");
    const DWORD before = OpenHandles();
    CHECK(Scan(*messages, inbox.Name()) == "457");
    CHECK(Scan(*messages, inbox.Name("none")) == "30030");
    CHECK(OpenHandles() == before);
}
