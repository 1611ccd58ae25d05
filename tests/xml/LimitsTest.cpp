// No limits by accident: depth, numbers and lengths are bounded by memory alone.
#include "Documents.h"

#ifdef _WIN32
#include <windows.h>
#else
#include <sys/mman.h>
#endif

namespace varnex3::xml {
namespace {

std::string Repeated(std::string_view text, std::size_t count)
{
    std::string repeated;
    repeated.reserve(text.size() * count);
    for (std::size_t i = 0; i < count; ++i)
        repeated += text;
    return repeated;
}

constexpr std::size_t million = 1'000'000;

// Memory that is there in name only, all zeros until it is written.
class ZeroBytes
{
public:
#ifdef _WIN32
    explicit ZeroBytes(std::size_t count)
        : size(count), memory(VirtualAlloc(nullptr, size, MEM_RESERVE | MEM_COMMIT, PAGE_READONLY))
    {
        REQUIRE(memory != nullptr);
    }
    ~ZeroBytes() { VirtualFree(memory, 0, MEM_RELEASE); }
#else
    explicit ZeroBytes(std::size_t count)
        : size(count), memory(mmap(nullptr, size, PROT_READ, MAP_PRIVATE | MAP_ANONYMOUS | MAP_NORESERVE, -1, 0))
    {
        REQUIRE(memory != MAP_FAILED);
    }
    ~ZeroBytes() { munmap(memory, size); }
#endif
    ZeroBytes(const ZeroBytes&) = delete;
    ZeroBytes& operator=(const ZeroBytes&) = delete;

    std::string_view Bytes() const { return {static_cast<const char*>(memory), size}; }
    std::u16string_view Text() const { return {static_cast<const char16_t*>(memory), size / 2}; }

private:
    std::size_t size;
    void* memory;
};

} // namespace

TEST_CASE("A million levels are parsed, searched, read, written and destroyed")
{
    const Document document = LoadedBytes(Repeated("<a>", million) + "x" + Repeated("</a>", million));
    CHECK(document.Root().Text() == u"x");
    CHECK(document.ElementsByTagName("a").size() == million);
    CHECK(document.ElementsByTagName("a/a").size() == million - 1);
    const std::u16string written = document.Xml();
    CHECK(Loaded(written).Xml() == written);
}

TEST_CASE("A path of a million steps leads down a million levels")
{
    const Document document = LoadedBytes(Repeated("<a>", million) + Repeated("</a>", million));
    const std::string path = Repeated("a/", million - 1) + "a";
    CHECK(document.SelectSingle(path));
    CHECK(document.Select(path).size() == 1);
    CHECK_FALSE(document.SelectSingle(path + "/a"));
}

TEST_CASE("A million levels of namespaces and of preserved white space")
{
    const std::string start = "<p:a xmlns:p='u' xml:space='preserve'> ";
    const Document document = LoadedBytes(Repeated(start, million) + Repeated("</p:a>", million));
    CHECK(document.Root().Text().size() == million);
}

TEST_CASE("Layout ends 100 levels down, so that deep documents do not drown in TABs")
{
    const Document document = LoadedBytes(Repeated("<a>", 1000) + Repeated("</a>", 1000));
    const std::u16string written = document.Xml();
    CHECK(written.size() < 1000 * 7 + 2 * 100 * 102 + 2);
    CHECK(written.find(std::u16string(100, u'\t') + u"<a>") != written.npos);
    CHECK(written.find(std::u16string(101, u'\t')) == written.npos);
}

TEST_CASE("A million siblings are all found, in order")
{
    std::string bytes = "<r>";
    for (std::size_t i = 0; i < million; ++i)
        bytes += "<i>" + std::to_string(i) + "</i>";
    const Document document = LoadedBytes(bytes + "</r>");
    const NodeList items = document.Select("r/i");
    REQUIRE(items.size() == million);
    CHECK(items[0].Text() == u"0");
    CHECK(items[million - 1].Text() == u"999999");
}

TEST_CASE("An element may have 100,000 attributes; the one that is there twice is found")
{
    std::string bytes = "<a";
    for (int i = 0; i < 100'000; ++i)
        bytes += " b" + std::to_string(i) + "='" + std::to_string(i) + "'";
    const Document document = LoadedBytes(bytes + "/>");
    CHECK(document.DocumentElement().AttributeCount() == 100'000);
    CHECK(document.DocumentElement().AttributeAt(99'999).value == u"99999");

    Document twice;
    CHECK_FALSE(twice.LoadBytes(bytes + " b77777=''/>"));
    CHECK(twice.Error().code == ErrorCode::DuplicateAttribute);
    CHECK(twice.Error().column == bytes.size() + 2);
}

TEST_CASE("An element may declare 100,000 prefixes and use them all")
{
    std::string declarations;
    std::string uses;
    for (int i = 0; i < 100'000; ++i) {
        declarations += " xmlns:p" + std::to_string(i) + "='u" + std::to_string(i) + "'";
        uses += " p" + std::to_string(i) + ":b=''";
    }
    const Document document = LoadedBytes("<a" + declarations + "><b" + uses + "/></a>");
    CHECK(document.SelectSingle("a/b").AttributeCount() == 100'000);
    const std::string part = ToUtf8(document.SelectSingle("a/b").Xml());
    CHECK(part == "<b" + uses + declarations + "/>");

    Document twice;
    CHECK_FALSE(twice.LoadBytes("<a" + declarations + " xmlns:q='u5'><b" + uses + " q:b=''/></a>"));
    CHECK(twice.Error().code == ErrorCode::DuplicateAttribute);
}

TEST_CASE("A name may be longer than 65,535 characters")
{
    for (const std::size_t length : {65'534u, 65'535u, 65'536u, 200'000u}) {
        const std::string name(length, 'n');
        const std::string bytes =
            "<" + name + " " + name + "='1'><?" + name + " x?><" + name + ">y</" + name + "></" + name + ">";
        const Document document = LoadedBytes(bytes);
        CHECK(document.DocumentElement().IsElement(name));
        CHECK(document.DocumentElement().AttributeAt(0).name.size() == length);
        CHECK(document.DocumentElement().FirstChild().Name().size() == length);
        CHECK(document.SelectSingle(name + "/" + name).Text() == u"y");
        CHECK(Loaded(document.Xml()).Xml() == document.Xml());
        Document other;
        CHECK_FALSE(other.LoadBytes("<" + name + "></" + name + "n>"));
        CHECK(other.Error().code == ErrorCode::TagMismatch);
    }
}

TEST_CASE("Text and values of every length around the blocks of sixteen are read whole")
{
    for (std::size_t length = 0; length < 70; ++length) {
        const std::u16string filler(length, u'x');
        const Document document = Loaded(u"<a b='" + filler + u"&amp;'>" + filler + u"&lt;\u00E9" + filler + u"</a>");
        CHECK(document.Root().Text() == filler + u"<\u00E9" + filler);
        CHECK(document.DocumentElement().AttributeAt(0).value == filler + u"&");
        CHECK(LoadedBytes(ToUtf8(document.Xml())).Root().Text() == document.Root().Text());
        Document bad;
        CHECK_FALSE(bad.LoadText(u"<a>" + filler + u"\u0001</a>"));
        CHECK(bad.Error().column == length + 4);
    }
}

TEST_CASE("Gigabytes of zeros are refused at the first")
{
    const std::size_t count = sizeof(void*) < 8 ? std::size_t{1} << 29 : std::size_t{1} << 31; // as much as it can hold
    const ZeroBytes zeros(count);
    Document document;
    CHECK_FALSE(document.LoadBytes(zeros.Bytes()));
    CHECK(document.Error().code == ErrorCode::InvalidCharacter);
    CHECK(document.Error().column == 1);
    CHECK(document.Error().reason == u"The character U+0000 is not allowed in XML");
    CHECK_FALSE(document.LoadText(zeros.Text()));
    CHECK(document.Error().code == ErrorCode::InvalidCharacter);
}

TEST_CASE("A text of more than 4,294,967,295 characters is too large")
{
    if constexpr (sizeof(std::size_t) > 4) {
        const ZeroBytes zeros(static_cast<std::size_t>(std::uint64_t{1} << 33));
        Document document;
        CHECK_FALSE(document.LoadBytes(zeros.Bytes()));
        CHECK(document.Error().code == ErrorCode::TooLarge);
        CHECK_FALSE(document.LoadText(zeros.Text()));
        CHECK(document.Error().code == ErrorCode::TooLarge);
        CHECK(document.Error().reason == u"The text is longer than 4,294,967,295 characters");
        CHECK_FALSE(document.LoadBytes(zeros.Bytes().substr(0, 0xFFFFFFFF)));
        CHECK(document.Error().code == ErrorCode::InvalidCharacter);
    }
}

} // namespace varnex3::xml
