// Conversions between UTF-8 and UTF-16.
#include "Documents.h"

namespace varnex3::xml {

TEST_CASE("UTF-8 and UTF-16 are converted into each other")
{
    CHECK(ToUtf16("caf\xC3\xA9") == u"caf\u00E9");
    CHECK(ToUtf16("\xE2\x82\xAC\xF0\x9F\x98\x80") == u"\u20AC\U0001F600");
    CHECK(ToUtf8(u"caf\u00E9") == "caf\xC3\xA9");
    CHECK(ToUtf8(u"\u20AC\U0001F600") == "\xE2\x82\xAC\xF0\x9F\x98\x80");
    CHECK(ToUtf16("") == u"");
    CHECK(ToUtf8(u"") == "");
    CHECK(ToUtf8(std::u16string(1, 0)) == std::string(1, '\0'));
}

TEST_CASE("Appending keeps what is there")
{
    std::u16string text = u"\u20AC";
    AppendUtf16(text, "x\xC3\xA9");
    AppendUtf16(text, "");
    CHECK(text == u"\u20ACx\u00E9");
}

TEST_CASE("A malformed sequence becomes one replacement character, what follows stays")
{
    CHECK(ToUtf16("a\xFF"
                  "b")
          == u"a\uFFFDb");
    CHECK(ToUtf16("a\x80") == u"a\uFFFD");
    CHECK(ToUtf16("\xC3") == u"\uFFFD");
    CHECK(ToUtf16("\xC3"
                  "x")
          == u"\uFFFDx");
    CHECK(ToUtf16("\xE2\x82") == u"\uFFFD");
    CHECK(ToUtf16("\xE2\x82"
                  "x")
          == u"\uFFFDx");
    CHECK(ToUtf16("\xF0\x9F\x98\xC3\xA9") == u"\uFFFD\u00E9");
    CHECK(ToUtf16("\xC0\x80").find(u'\0') == std::u16string::npos); // the overlong zero is no zero
}

TEST_CASE("Lone surrogates come back, alone and beside others")
{
    for (const std::u16string& text :
         {std::u16string(1, 0xD800), std::u16string(1, 0xDFFF), std::u16string{0xDC00, 0xD800},
          std::u16string{u'a', 0xDBFF, u'b'}, std::u16string{0xD800, 0xD83D, 0xDE00}, std::u16string{0xDC80, 0xDC81}})
        CHECK(ToUtf16(ToUtf8(text)) == text);
    CHECK(ToUtf8(std::u16string(1, 0xD800)) == "\xED\xA0\x80");
}

TEST_CASE("Every 16-bit unit comes back, at every place of a long text")
{
    for (char32_t c = 0; c <= 0xFFFF; c += 7) {
        std::u16string text(40, u'x');
        text[c % 40] = static_cast<char16_t>(c);
        if (ToUtf16(ToUtf8(text)) != text)
            FAIL_CHECK(static_cast<unsigned>(c));
    }
}

TEST_CASE("Every length around the blocks of sixteen comes back")
{
    for (std::size_t length = 0; length < 70; ++length)
        for (const char16_t last : {u'z', u'\u00E9', u'\u20AC'}) {
            const std::u16string text = std::u16string(length, u'a') + last + std::u16string(length, u'b');
            CHECK(ToUtf16(ToUtf8(text)) == text);
        }
}

} // namespace varnex3::xml
