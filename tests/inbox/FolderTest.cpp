// Scans of folders with files of every content.
#include "tests/Printing.h"
#include "tests/TemporaryFolder.h"
#include "tests/inbox/Scans.h"
#include "varnex3/inbox/InboxFolder.h"

using namespace varnex3;
using tests::RaisedBy;
using tests::Scan;
using tests::TemporaryFolder;

namespace fs = std::filesystem;

TEST_CASE("An empty file gets an entry with the error of an empty document")
{
    const TemporaryFolder inbox;
    inbox.Write("a.xml", "");
    const auto messages = New<Xalo_Messages>();
    const auto expected = New<MessageDef>();
    expected->ParseXML(u"", u"a.xml", Text());
    CHECK(Scan(*messages, inbox.Name()) == "fine");
    CHECK(messages->MessageItems(std::int32_t{0})->ErrorMessage() == expected->ErrorMessage());
    CHECK(expected->ErrorMessage().size() > TextView(u"File: a.xml; Error Line: 1; Error Reason: ''").size());
}

TEST_CASE("Two different faults of files have the same error text: that of an empty document")
{
    const TemporaryFolder inbox;
    inbox.Write("a.xml", "<Foo>\n\n<Bar>");
    const auto messages = New<Xalo_Messages>();
    const auto expected = New<MessageDef>();
    expected->ParseXML(u"", u"a.xml", Text());
    CHECK(Scan(*messages, inbox.Name()) == "fine");
    CHECK(messages->MessageItems(std::int32_t{0})->ErrorMessage() == expected->ErrorMessage());
}

TEST_CASE("Binary data gets an entry with a parse error")
{
    const TemporaryFolder inbox;
    std::string bytes;
    for (int i = 0; i < 100000; ++i)
        bytes += static_cast<char>(i * 37 + i / 256);
    inbox.Write("a.xml", bytes);
    inbox.Write("b.xml", std::string(1000, '\0'));
    const auto messages = New<Xalo_Messages>();
    CHECK(Scan(*messages, inbox.Name()) == "fine");
    CHECK(messages->MessageItems(std::int32_t{0})->ParseError());
    CHECK(messages->MessageItems(std::int32_t{1})->ParseError());
}

TEST_CASE("A zero in a path is never cut off at: 30030, the path unchanged")
{
    const TemporaryFolder inbox;
    const Text path = inbox.Name() + Text(u"\0/none", 6);
    std::int32_t number = 0;
    Text description;
    CHECK_FALSE(New<Xalo_Messages>()->ParseFiles(path, &number, &description));
    CHECK(number == 30030);
    CHECK(description == u"Folder '" + path + u"' does not exist.");
}

TEST_CASE("A zero in a path is never cut off at: saveToFile writes no file of another name")
{
    const TemporaryFolder folder;
    const auto message = New<MessageDef>();
    message->ParseXML(u"<Foo/>", u"", Text());
    CHECK(RaisedBy([&] { message->saveToFile(folder.Name("a") + Text(u"\0b", 2)); }) == "75 MessageDef.saveToFile");
    CHECK(fs::is_empty(folder.Path()));
}

TEST_CASE("A file that vanishes after it was listed is 53")
{
    const TemporaryFolder folder;
    folder.Write("a.xml", "<Foo/>");
    InboxFolder inbox(folder.Name());
    CHECK(inbox.FileNames() == std::vector<Text>{u"a.xml"});
    fs::remove(folder.Path("a.xml"));
    xml::Document document;
    CHECK(RaisedBy([&] { inbox.Load(u"a.xml", document); }) == "53 Xalo_Messages.ParseFiles");
}

TEST_CASE("A folder may be listed again, and then has what is in it then")
{
    const TemporaryFolder folder;
    folder.Write("a.xml", "");
    const InboxFolder inbox(folder.Name());
    CHECK(inbox.FileNames().size() == 1);
    folder.Write("b.xml", "");
    CHECK(inbox.FileNames().size() == 2);
}

TEST_CASE("A file of 2 GB is no trouble for the files after it")
{
    const TemporaryFolder inbox;
    inbox.Write("a.xml", "<Foo/>");
    inbox.Write("b.xml", "");
    fs::resize_file(inbox.Path("b.xml"), std::uintmax_t{1} << 31); // a hole: nothing is written
    inbox.Write("c.xml", "<Foo/>");
    const auto messages = New<Xalo_Messages>();
    if constexpr (sizeof(void*) < 8) { // more than such a program can hold: out of memory
        CHECK(Scan(*messages, inbox.Name()) == "7");
        CHECK(messages->Count() == 1);
        return;
    }
    CHECK(Scan(*messages, inbox.Name()) == "fine");
    REQUIRE(messages->Count() == 3);
    CHECK(messages->MessageItems(std::int32_t{1})->ParseError());
    CHECK(messages->MessageItems(std::int32_t{2})->FileName() == u"c.xml");
}

TEST_CASE("A folder of thousands of files is read whole, in name order")
{
    const TemporaryFolder inbox;
    for (int i = 0; i < 3000; ++i)
        inbox.Write(std::to_string(i) + ".xml", "<Foo/>");
    const auto messages = New<Xalo_Messages>();
    CHECK(Scan(*messages, inbox.Name()) == "fine");
    CHECK(messages->Count() == 3000);
    Text before;
    for (std::int32_t i = 0; i < 3000; ++i) {
        const Text name = messages->MessageItems(i)->FileName();
        CHECK(before < name);
        before = name;
    }
}
