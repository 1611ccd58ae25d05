// Scans of folders where the system is POSIX: permissions, links, devices, names that are bytes.
#include <fcntl.h>
#include <sys/resource.h>
#include <sys/stat.h>
#include <sys/wait.h>
#include <unistd.h>

#include <functional>

#include "tests/Printing.h"
#include "tests/TemporaryFolder.h"
#include "tests/inbox/Scans.h"

using namespace varnex3;
using tests::RaisedBy;
using tests::Scan;
using tests::TemporaryFolder;

namespace {

namespace fs = std::filesystem;

std::ptrdiff_t OpenDescriptors()
{
    const fs::directory_iterator entries("/proc/self/fd");
    return std::distance(begin(entries), end(entries));
}

// Does something in a process of its own as a user without privileges; what it says there.
std::string AsNobody(const std::function<std::string()>& action)
{
    constexpr uid_t kNobody = 65534;
    int ends[2];
    REQUIRE(pipe(ends) == 0);
    const pid_t child = fork();
    REQUIRE(child >= 0);
    if (child == 0) {
        const bool isNobody = getuid() != 0 || (setgid(kNobody) == 0 && setuid(kNobody) == 0);
        std::string said;
        try {
            said = isNobody ? action() : "still root";
        } catch (const std::exception& error) {
            said = error.what();
        }
        const bool isWhole = write(ends[1], said.data(), said.size()) == static_cast<ssize_t>(said.size());
        _exit(isWhole ? 0 : 1);
    }
    close(ends[1]);
    std::string said(100, '\0');
    const ssize_t size = read(ends[0], said.data(), said.size());
    close(ends[0]);
    int status = 0;
    waitpid(child, &status, 0);
    CHECK(status == 0);
    said.resize(static_cast<std::size_t>(std::max<ssize_t>(size, 0)));
    return said;
}

} // namespace

TEST_CASE("A file that vanished is 53, and what was added before it stays")
{
    const TemporaryFolder inbox;
    inbox.Write("a.xml", "<Foo/>");
    fs::create_symlink("nowhere", inbox.Path("b.xml")); // a name that leads to no file
    inbox.Write("c.xml", "<Foo/>");
    const auto messages = New<Xalo_Messages>();
    CHECK(Scan(*messages, inbox.Name()) == "53");
    CHECK(messages->Count() == 1);
    CHECK(messages->MessageItems(std::int32_t{0})->FileName() == u"a.xml");
}

TEST_CASE("The description of a file that cannot be read names it")
{
    const TemporaryFolder inbox;
    fs::create_symlink("nowhere", inbox.Path("b.xml"));
    Text description;
    CHECK_FALSE(New<Xalo_Messages>()->ParseFiles(inbox.Name(), nullptr, &description));
    CHECK(description.find(u"b.xml") != Text::npos);
}

TEST_CASE("A file without permission is 70, and what was added before it stays")
{
    const TemporaryFolder inbox;
    inbox.Write("a.xml", "<Foo/>");
    inbox.Write("b.xml", "<Foo/>");
    inbox.Write("c.xml", "<Foo/>");
    fs::permissions(inbox.Path("a.xml"), fs::perms::all);
    fs::permissions(inbox.Path("b.xml"), fs::perms::none);
    fs::permissions(inbox.Path(), fs::perms::all);
    CHECK(AsNobody([&] {
              const auto messages = New<Xalo_Messages>();
              const std::string ended = Scan(*messages, inbox.Name());
              return ended + " " + std::to_string(messages->Count());
          })
          == "70 1");
}

TEST_CASE("A folder without permission exists, and is 70")
{
    const TemporaryFolder inbox;
    inbox.Write("a.xml", "<Foo/>");
    fs::permissions(inbox.Path(), fs::perms::none);
    CHECK(AsNobody([&] { return Scan(*New<Xalo_Messages>(), inbox.Name()); }) == "70");
}

TEST_CASE("A folder inside one that may not be entered does not exist for the scan")
{
    const TemporaryFolder outer;
    fs::create_directory(outer.Path("inner"));
    fs::permissions(outer.Path(), fs::perms::none);
    CHECK(AsNobody([&] { return Scan(*New<Xalo_Messages>(), outer.Name("inner")); }) == "30030");
}

TEST_CASE("Folders, pipes, sockets and devices are no files, whatever their names")
{
    const TemporaryFolder inbox;
    fs::create_directory(inbox.Path("folder.xml"));
    REQUIRE(mkfifo(inbox.Path("pipe.xml").c_str(), 0600) == 0); // opening it would wait for ever
    fs::create_symlink("/dev/zero", inbox.Path("device.xml"));
    fs::create_symlink("pipe.xml", inbox.Path("link to pipe.xml"));
    fs::create_directory_symlink("folder.xml", inbox.Path("link to folder.xml"));
    inbox.Write("a.xml", "<Foo/>");
    const auto messages = New<Xalo_Messages>();
    CHECK(Scan(*messages, inbox.Name()) == "fine");
    CHECK(messages->Count() == 1);
}

TEST_CASE("A link to a file is a file, under the name of the link")
{
    const TemporaryFolder inbox;
    const TemporaryFolder elsewhere;
    elsewhere.Write("message", "<Foo><MessageNo>1</MessageNo></Foo>");
    fs::create_symlink(elsewhere.Path("message"), inbox.Path("a.xml"));
    const auto messages = New<Xalo_Messages>();
    CHECK(Scan(*messages, inbox.Name()) == "fine");
    CHECK(messages->MessageItems(Text(u"a.xml"))->MessageNo() == u"1");
}

TEST_CASE("A link that leads to itself ends the scan with an error")
{
    const TemporaryFolder inbox;
    fs::create_symlink("a.xml", inbox.Path("a.xml"));
    const auto messages = New<Xalo_Messages>();
    CHECK(Scan(*messages, inbox.Name()) == "57");
    CHECK(messages->Count() == 0);
}

TEST_CASE("A link to a folder is a folder")
{
    const TemporaryFolder outer;
    fs::create_directory(outer.Path("inbox"));
    outer.Write("inbox/a.xml", "<Foo/>");
    fs::create_directory_symlink("inbox", outer.Path("link"));
    const auto messages = New<Xalo_Messages>();
    CHECK(Scan(*messages, outer.Name("link")) == "fine");
    CHECK(messages->MessageItems(std::int32_t{0})->FilePath() == outer.Name("link/a.xml"));
}

TEST_CASE("A name that is not UTF-8 is a key that finds its file, and a path that opens it")
{
    const TemporaryFolder inbox;
    inbox.Write("caf\xE9.xml", "<Foo><MessageNo>1</MessageNo></Foo>");
    const auto messages = New<Xalo_Messages>();
    CHECK(Scan(*messages, inbox.Name()) == "fine");
    const auto message = messages->MessageItems(std::int32_t{0});
    CHECK(message->MessageNo() == u"1");
    CHECK(messages->MessageItems(message->FileName()) == message);
    fs::remove(inbox.Path("caf\xE9.xml"));
    message->saveToFile(message->FilePath());
    CHECK(fs::exists(inbox.Path("caf\xE9.xml")));
}

TEST_CASE("A folder whose name is not UTF-8 is scanned by the name that the system gives")
{
    const TemporaryFolder outer;
    fs::create_directory(outer.Path("in\xFF"));
    outer.Write("in\xFF/a.xml", "<Foo/>");
    CHECK(Scan(*New<Xalo_Messages>(), outer.Name() + u"/in\xDCFF") == "fine");
}

TEST_CASE("saveToFile without permission is 75, the old file stays, and nothing is left behind")
{
    const TemporaryFolder folder;
    folder.Write("a.xml", "old");
    fs::permissions(folder.Path(), fs::perms::owner_all | fs::perms::others_read | fs::perms::others_exec);
    CHECK(AsNobody([&] {
              const auto message = New<MessageDef>();
              message->ParseXML(u"<Foo/>", u"", Text());
              return RaisedBy([&] { message->saveToFile(folder.Name("a.xml")); });
          })
          == "75 MessageDef.saveToFile");
    CHECK(tests::BytesOf(folder.Path("a.xml")) == "old");
    CHECK(std::distance(fs::directory_iterator(folder.Path()), {}) == 1);
}

TEST_CASE("No file stays open, whatever a scan meets")
{
    const TemporaryFolder inbox;
    inbox.Write("a.xml", "<Foo/>");
    inbox.Write("b.xml", "<Foo>");
    const auto messages = New<Xalo_Messages>();
    const std::ptrdiff_t before = OpenDescriptors();
    CHECK(Scan(*messages, inbox.Name()) == "fine");
    CHECK(Scan(*messages, inbox.Name()) == "457");
    CHECK(Scan(*messages, inbox.Name("none")) == "30030");
    CHECK(Scan(*messages, inbox.Name("a.xml")) == "30030");
    fs::create_symlink("nowhere", inbox.Path("0.xml"));
    CHECK(Scan(*messages, inbox.Name()) == "53");
    CHECK(OpenDescriptors() == before);
}

TEST_CASE("A scan that may open no more files ends with an error, and works again afterwards")
{
    const TemporaryFolder inbox;
    inbox.Write("a.xml", "<Foo/>");
    rlimit whole{};
    REQUIRE(getrlimit(RLIMIT_NOFILE, &whole) == 0);
    const rlimit none{0, whole.rlim_max};
    const auto messages = New<Xalo_Messages>();
    REQUIRE(setrlimit(RLIMIT_NOFILE, &none) == 0);
    const std::string ended = Scan(*messages, inbox.Name());
    REQUIRE(setrlimit(RLIMIT_NOFILE, &whole) == 0);
    CHECK(ended == "57");
    CHECK(messages->Count() == 0);
    CHECK(Scan(*messages, inbox.Name()) == "fine");
}
