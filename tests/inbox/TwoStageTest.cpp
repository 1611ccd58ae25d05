// A scan reads each file once. What it gives must be what the reading in two stages gives that hosts rely on: the file
// loaded into a document, and the document's text, written out again, given to ParseXML.
#include <random>

#include "tests/Printing.h"
#include "tests/TemporaryFolder.h"
#include "varnex3/core/Json.h"
#include "varnex3/inbox/Xalo_Messages.h"
#include "varnex3/xml/Document.h"

using namespace varnex3;
using tests::NameOf;
using tests::TemporaryFolder;

namespace {

namespace fs = std::filesystem;

Ref<MessageDef> InTwoStages(const fs::path& file)
{
    xml::Document document;
    document.LoadFile(NameOf(file));
    const auto message = New<MessageDef>();
    message->ParseXML(document.Xml(), NameOf(file.filename()), NameOf(file));
    return message;
}

// What saveToFile writes; "no file" when it writes none.
std::string Saved(MessageDef& message, const TemporaryFolder& folder)
{
    const fs::path file = folder.Path("saved");
    fs::remove(file);
    message.saveToFile(NameOf(file));
    return fs::exists(file) ? tests::BytesOf(file) : "no file";
}

// Scans a folder and compares each entry; the number of entries that were read and of those that were not.
std::pair<int, int> CompareAll(const fs::path& inbox)
{
    const TemporaryFolder target;
    const auto messages = New<Xalo_Messages>();
    std::int32_t number = 0;
    Text description;
    CHECK(messages->ParseFiles(NameOf(inbox), &number, &description));
    CHECK(description == u"");

    std::pair<int, int> count;
    for (const fs::directory_entry& entry : fs::directory_iterator(inbox)) {
        std::string extension = entry.path().extension().string();
        for (char& c : extension)
            c = c >= 'A' && c <= 'Z' ? static_cast<char>(c + 32) : c;
        if (extension != ".xml" || !entry.is_regular_file())
            continue;
        CAPTURE(entry.path().string());
        const Ref<MessageDef> scanned = messages->MessageItems(NameOf(entry.path().filename()));
        const Ref<MessageDef> expected = InTwoStages(entry.path());
        REQUIRE(static_cast<bool>(scanned));
        CHECK(scanned->SourceXML() == expected->SourceXML());
        CHECK(ToJson(*scanned) == ToJson(*expected));
        CHECK(Saved(*scanned, target) == Saved(*expected, target));
        ++(expected->ParseError() ? count.second : count.first);
    }
    CHECK(messages->Count() == count.first + count.second);
    return count;
}

// A file with a piece of it removed, repeated, exchanged for one of another file, or changed in one byte.
std::string Damaged(std::string bytes, const std::string& other, std::mt19937& random)
{
    const auto below = [&](std::size_t limit) { return limit == 0 ? 0 : random() % limit; };
    const std::size_t at = below(bytes.size());
    switch (bytes.empty() ? 2 : random() % 6) {
    case 0:
        return bytes.erase(at, 1 + below(30));
    case 1:
        return bytes.insert(at, bytes.substr(below(bytes.size()), below(60)));
    case 2:
        return bytes.insert(at, other.substr(below(other.size()), below(60)));
    case 3:
        bytes[at] = static_cast<char>(random());
        return bytes;
    case 4: // between two elements
        return bytes.insert(bytes.find('>', at) + 1, random() % 2 == 0 ? " \r\n<!-- c -->&#32;" : "<![CDATA[ <&> ]]>");
    default:
        bytes.resize(random() % 8 == 0 ? at : bytes.size());
        return bytes;
    }
}

const fs::path kSamples = VARNEX3_SOURCE_DIR "/samples/inbox";

} // namespace

TEST_CASE("Every sample is summarised as in two stages")
{
    const auto [read, broken] = CompareAll(kSamples);
    CHECK(read == 55);
    CHECK(broken == 16);
}

TEST_CASE("Every damaged sample is summarised as in two stages")
{
    std::vector<std::string> samples;
    for (const fs::directory_entry& entry : fs::directory_iterator(kSamples))
        if (entry.is_regular_file())
            samples.push_back(tests::BytesOf(entry.path()));
    std::ranges::sort(samples);

    std::mt19937 random(5);
    const TemporaryFolder inbox;
    constexpr int kDamages = 8; // of each sample
    for (int i = 0; i < kDamages; ++i)
        for (const std::string& sample : samples)
            inbox.Write(std::to_string(random()) + ".xml", Damaged(sample, samples[random() % samples.size()], random));
    const auto [read, broken] = CompareAll(inbox.Path());
    CHECK(read > 100);
    CHECK(broken > 100);
}

TEST_CASE("Declarations, encodings and layouts are summarised as in two stages")
{
    const TemporaryFolder inbox;
    const char* const declarations[] = {"", "<?xml version='1.0'?>", "<?xml version=\"1.0\" encoding=\"utf-8\"?>\r\n",
                                        "<?xml version='1.0' standalone='yes'?>\n",
                                        "<?xml version='1.0' encoding='ISO-8859-1' standalone='no'?>"};
    const char* const prologs[] = {"", "<!-- c -->", "<?p i?>\r\n", "<!DOCTYPE Foo SYSTEM 'foo.dtd'>"};
    const char* const roots[] = {"<Foo/>",
                                 "<Foo><MessageNo>1</MessageNo></Foo>",
                                 "<Foo xml:space='preserve'> <A> </A> </Foo>",
                                 "<p:Foo xmlns:p='urn:p'><MessageNo p:a='1'>\xE9</MessageNo></p:Foo>",
                                 "<Foo>\xC3\xA9&#13;</Foo>",
                                 "<Foo><QuoteNo><![CDATA[]]]]><![CDATA[>]]></QuoteNo></Foo><!-- end -->"};
    int i = 0;
    for (const std::string declaration : declarations)
        for (const std::string prolog : prologs)
            for (const std::string root : roots)
                inbox.Write(std::to_string(i++) + ".xml", declaration + prolog + root);
    const auto [read, broken] = CompareAll(inbox.Path());
    CHECK(read > 60);
    CHECK(broken > 0);
}
