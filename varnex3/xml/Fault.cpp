// Lines, columns and sentences: computed only when there is an error.
#include "varnex3/xml/Fault.h"

#include "varnex3/xml/Characters.h"
#include "varnex3/xml/References.h"

namespace varnex3::xml {
namespace {

constexpr std::size_t longestQuote = 60;

constexpr bool StartsPoint(char c) { return (Unit(c) & 0xC0) != 0x80; }
constexpr bool StartsPoint(char16_t c) { return !IsLowSurrogate(c); }

struct Place
{
    std::uint32_t line = 1;
    std::uint32_t column = 1;
};

template <class Char>
Place PlaceOf(const Char* at, std::basic_string_view<Char> text)
{
    Place place;
    for (const Char* p = text.data(); p < at; ++p) {
        const bool endsLine = *p == '\n' || (*p == '\r' && (p + 1 == text.data() + text.size() || p[1] != '\n'));
        if (endsLine)
            place = {place.line + 1, 1};
        else if (StartsPoint(*p))
            ++place.column;
    }
    return place;
}

// A name as a sentence has it: not all of a very long one.
template <class Char>
std::u16string Quote(std::basic_string_view<Char> name)
{
    std::u16string quote;
    AppendPlain(quote, name.substr(0, longestQuote));
    if (name.size() > longestQuote)
        quote += u"...";
    return quote;
}

std::u16string Hexadecimal(char32_t number, int digits)
{
    std::u16string text;
    for (; number != 0 || digits > 0; number >>= 4, --digits)
        text.insert(text.begin(), u"0123456789ABCDEF"[number & 0xF]);
    return text;
}

// A character as itself where it can be seen, as its code point otherwise.
template <class Char>
std::u16string NameCharacter(const Char* at, const Char* end)
{
    if (at >= end)
        return u"end of the text";
    const CodePoint point = DecodePoint(at, end);
    if (point.length == 0)
        return sizeof(Char) == 1 ? u"byte 0x" + Hexadecimal(Unit(*at), 2) : u"surrogate 0x" + Hexadecimal(Unit(*at), 4);
    std::u16string name = u"character U+" + Hexadecimal(point.value, 4);
    if (point.value > 0x20 && point.value < 0x7F)
        (name += u" '") += {static_cast<char16_t>(point.value), u'\''};
    return name;
}

} // namespace

template <class Char>
ParseError Report(const Fault<Char>& fault, std::basic_string_view<Char> text)
{
    const Place place = PlaceOf(fault.at, text);
    ParseError error{fault.code, place.line, place.column, {}};
    for (const char* p = fault.sentence; *p != '\0'; ++p) {
        if (*p != '%') {
            error.reason += static_cast<char16_t>(*p);
            continue;
        }
        switch (*++p) {
        case '1':
            error.reason += Quote(fault.first);
            break;
        case '2':
            error.reason += Quote(fault.second);
            break;
        default:
            error.reason += NameCharacter(fault.at, text.data() + text.size());
            break;
        }
    }
    return error;
}

template ParseError Report(const Fault<char>&, std::string_view);
template ParseError Report(const Fault<char16_t>&, std::u16string_view);

} // namespace varnex3::xml
