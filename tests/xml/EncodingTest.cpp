// Files in other encodings than UTF-8.
#include "Documents.h"

namespace varnex3::xml {
namespace {

enum class Order
{
    LittleEndian,
    BigEndian
};

std::string Utf16Bytes(std::u16string_view text, Order order)
{
    std::string bytes;
    for (const char16_t c : text) {
        const char low = static_cast<char>(static_cast<unsigned char>(c & 0xFF));
        const char high = static_cast<char>(static_cast<unsigned char>(c >> 8));
        bytes += order == Order::LittleEndian ? std::string{low, high} : std::string{high, low};
    }
    return bytes;
}

std::string Declared(std::string_view encoding, std::string_view content)
{
    return "<?xml version=\"1.0\" encoding=\"" + std::string(encoding) + "\"?><a>" + std::string(content) + "</a>";
}

std::u16string TextOfBytes(std::string_view bytes) { return LoadedBytes(bytes).Root().Text(); }

ParseError ErrorOf(std::string_view bytes)
{
    Document document;
    CHECK_FALSE(document.LoadBytes(bytes));
    return document.Error();
}

} // namespace

TEST_CASE("Without declaration and mark a file is UTF-8")
{
    CHECK(TextOfBytes("<a>caf\xC3\xA9 \xE2\x82\xAC \xF0\x9F\x98\x80</a>") == u"caf\u00E9 \u20AC \U0001F600");
    CHECK(TextOfBytes("\xEF\xBB\xBF<a>\xC3\xA9</a>") == u"\u00E9");
    CHECK(TextOfBytes(Declared("UTF-8", "\xC3\xA9")) == u"\u00E9");
    CHECK(TextOfBytes(Declared("utf-8", "\xC3\xA9")) == u"\u00E9");
}

TEST_CASE("UTF-16 is known by its mark or its first character, in either order")
{
    for (const Order order : {Order::LittleEndian, Order::BigEndian}) {
        CHECK(TextOfBytes(Utf16Bytes(u"\uFEFF<a>\u20AC\U0001F600</a>", order)) == u"\u20AC\U0001F600");
        CHECK(TextOfBytes(Utf16Bytes(u"<a>\u20AC\U0001F600</a>", order)) == u"\u20AC\U0001F600");
        CHECK(TextOfBytes(Utf16Bytes(u"\uFEFF<?xml version='1.0' encoding='UTF-16'?><a>\u20AC</a>", order))
              == u"\u20AC");
        CHECK(TextOfBytes(Utf16Bytes(u"<?xml version='1.0' encoding='UTF-16'?><a>\u20AC</a>", order)) == u"\u20AC");
    }
}

TEST_CASE("A mark, or evident UTF-16, outranks the declaration")
{
    CHECK(TextOfBytes("\xEF\xBB\xBF" + Declared("windows-1252", "\xC3\xA9")) == u"\u00E9");
    CHECK(TextOfBytes("\xEF\xBB\xBF" + Declared("klingon", "\xC3\xA9")) == u"\u00E9");
    CHECK(TextOfBytes(Utf16Bytes(u"\uFEFF<?xml version='1.0' encoding='UTF-8'?><a>\u20AC</a>", Order::BigEndian))
          == u"\u20AC");
    CHECK(TextOfBytes(Utf16Bytes(u"<?xml version='1.0' encoding='UTF-8'?><a>\u20AC</a>", Order::LittleEndian))
          == u"\u20AC");
}

TEST_CASE("ISO-8859-1 has each byte as its character")
{
    CHECK(TextOfBytes(Declared("ISO-8859-1", "\x41\x80\x9F\xA0\xE9\xFF")) == u"A\u0080\u009F\u00A0\u00E9\u00FF");
    CHECK(TextOfBytes(Declared("latin1", "\xE9")) == u"\u00E9");
}

TEST_CASE("windows-1252 has characters of its own from 0x80 on, and control characters where it has none")
{
    CHECK(TextOfBytes(Declared("windows-1252", "\x80\x82\x8A\x99\x9F\xA0\xE9\xFF"))
          == u"\u20AC\u201A\u0160\u2122\u0178\u00A0\u00E9\u00FF");
    CHECK(TextOfBytes(Declared("Windows-1252", "\x81\x8D\x8F\x90\x9D")) == u"\u0081\u008D\u008F\u0090\u009D");
    CHECK(TextOfBytes(Declared("cp1252", "\x93x\x94")) == u"\u201Cx\u201D");
}

TEST_CASE("US-ASCII has no other characters")
{
    CHECK(TextOfBytes(Declared("US-ASCII", "x&#233;")) == u"x\u00E9");
    const ParseError error = ErrorOf(Declared("us-ascii", "\r\nx\xE9"));
    CHECK(error.code == ErrorCode::InvalidSequence);
    CHECK(error.line == 2);
    CHECK(error.column == 2);
}

TEST_CASE("Lines and columns are those of the characters, whatever the encoding")
{
    CHECK(ErrorOf(Declared("windows-1252", "\x80\r\n\x80\x80&x;")).line == 2);
    CHECK(ErrorOf(Declared("windows-1252", "\x80\r\n\x80\x80&x;")).column == 3);
    CHECK(ErrorOf(Utf16Bytes(u"\uFEFF<a>\r\n\U0001F600&x;", Order::BigEndian)).line == 2);
    CHECK(ErrorOf(Utf16Bytes(u"\uFEFF<a>\r\n\U0001F600&x;", Order::BigEndian)).column == 2);
}

TEST_CASE("Any other encoding is refused by name, where the declaration has it")
{
    const ParseError error = ErrorOf("<?xml version='1.0'\r\n encoding='EUC-JP'?><a/>");
    CHECK(error.code == ErrorCode::UnknownEncoding);
    CHECK(error.reason == u"The encoding 'EUC-JP' is not supported");
    CHECK(error.line == 2);
    CHECK(error.column == 12);
    CHECK(ErrorOf(Declared("ISO-8859-15", "x")).code == ErrorCode::UnknownEncoding);
}

TEST_CASE("UTF-16 cannot be declared in bytes that are not")
{
    CHECK(ErrorOf(Declared("UTF-16", "x")).code == ErrorCode::UnknownEncoding);
    CHECK(ErrorOf(Declared("UTF-16LE", "x")).reason == u"The encoding 'UTF-16LE' is not supported");
}

TEST_CASE("UTF-32 and EBCDIC are refused by name")
{
    using namespace std::string_view_literals;
    for (const std::string_view bytes :
         {"\xFF\xFE\0\0<\0\0\0"sv, "\0\0\xFE\xFF\0\0\0<"sv, "<\0\0\0a\0\0\0"sv, "\0\0\0<\0\0\0a"sv}) {
        CHECK(ErrorOf(bytes).code == ErrorCode::UnknownEncoding);
        CHECK(ErrorOf(bytes).reason == u"The encoding 'UTF-32' is not supported");
    }
    CHECK(ErrorOf("\x4C\x6F\xA7\x94\x93").reason == u"The encoding 'EBCDIC' is not supported");
}

TEST_CASE("A declaration that is not well-formed is the fault, not its encoding")
{
    CHECK(ErrorOf("<?xml version='1.0' encoding='klingon' x?><a/>").code == ErrorCode::InvalidDeclaration);
    CHECK(ErrorOf("<?xml encoding='klingon'?><a/>").code == ErrorCode::InvalidDeclaration);
}

TEST_CASE("Half a character at the end of UTF-16 is a malformed sequence there")
{
    const ParseError error = ErrorOf(Utf16Bytes(u"\uFEFF<a/>", Order::LittleEndian) + "\n");
    CHECK(error.code == ErrorCode::InvalidSequence);
    CHECK(error.column == 5);
}

TEST_CASE("A file with nothing behind its mark has no root element")
{
    CHECK(ErrorOf("\xEF\xBB\xBF").code == ErrorCode::NoRootElement);
    CHECK(ErrorOf("\xFF\xFE").code == ErrorCode::NoRootElement);
}

} // namespace varnex3::xml
