// The character classes of XML 1.0 (fifth edition), and code points in UTF-8 and UTF-16.
#pragma once

#include <cstddef>
#include <cstdint>
#include <string>
#include <string_view>

namespace varnex3::xml {

// A code unit as a number that is never negative.
constexpr std::uint32_t Unit(char c) { return static_cast<unsigned char>(c); }
constexpr std::uint32_t Unit(char16_t c) { return c; }

template <class Char>
constexpr bool IsBlank(Char c)
{
    return c == ' ' || c == '\t' || c == '\n' || c == '\r';
}

template <class Char>
constexpr bool IsDigit(Char c)
{
    return c >= '0' && c <= '9';
}

template <class Char>
constexpr bool IsAsciiLetter(Char c)
{
    return (c >= 'a' && c <= 'z') || (c >= 'A' && c <= 'Z');
}

template <class Char>
constexpr bool EqualsAscii(std::basic_string_view<Char> text, std::string_view ascii)
{
    if (text.size() != ascii.size())
        return false;
    for (std::size_t i = 0; i < ascii.size(); ++i)
        if (text[i] != static_cast<Char>(ascii[i]))
            return false;
    return true;
}

constexpr bool IsHighSurrogate(char32_t c) { return c >= 0xD800 && c <= 0xDBFF; }
constexpr bool IsLowSurrogate(char32_t c) { return c >= 0xDC00 && c <= 0xDFFF; }

constexpr bool IsXmlCharacter(char32_t c)
{
    if (c < 0x20)
        return c == '\t' || c == '\n' || c == '\r';
    return c <= 0xD7FF || (c >= 0xE000 && c <= 0xFFFD) || (c >= 0x10000 && c <= 0x10FFFF);
}

namespace detail {

struct Range
{
    char32_t first, last;
};

template <std::size_t N>
constexpr bool IsInside(const Range (&ranges)[N], char32_t c)
{
    for (const Range& range : ranges)
        if (c >= range.first && c <= range.last)
            return true;
    return false;
}

inline constexpr Range nameStartRanges[] = {{'a', 'z'},       {'A', 'Z'},       {'_', '_'},       {':', ':'},
                                            {0xC0, 0xD6},     {0xD8, 0xF6},     {0xF8, 0x2FF},    {0x370, 0x37D},
                                            {0x37F, 0x1FFF},  {0x200C, 0x200D}, {0x2070, 0x218F}, {0x2C00, 0x2FEF},
                                            {0x3001, 0xD7FF}, {0xF900, 0xFDCF}, {0xFDF0, 0xFFFD}, {0x10000, 0xEFFFF}};

inline constexpr Range furtherNameRanges[] = {{'0', '9'}, {'-', '.'}, {0xB7, 0xB7}, {0x300, 0x36F}, {0x203F, 0x2040}};

} // namespace detail

constexpr bool IsNameStart(char32_t c) { return detail::IsInside(detail::nameStartRanges, c); }
constexpr bool IsNameCharacter(char32_t c) { return IsNameStart(c) || detail::IsInside(detail::furtherNameRanges, c); }

// One code point and the number of units that hold it. A malformed sequence has no length.
struct CodePoint
{
    char32_t value = 0;
    std::uint32_t length = 0;
};

constexpr CodePoint DecodePoint(const char16_t* p, const char16_t* end)
{
    const char32_t c = *p;
    if (!IsHighSurrogate(c) && !IsLowSurrogate(c))
        return {c, 1};
    if (IsLowSurrogate(c) || p + 1 >= end || !IsLowSurrogate(p[1]))
        return {};
    return {0x10000 + ((c - 0xD800) << 10) + (p[1] - 0xDC00u), 2};
}

namespace detail {

// What a leading byte says about its sequence: the length, its own bits, and the least value that needs this length.
struct Utf8Lead
{
    std::uint32_t length;
    char32_t bits;
    char32_t least;
};

constexpr Utf8Lead LeadOf(std::uint32_t byte)
{
    if (byte < 0x80)
        return {1, byte, 0};
    if (byte >= 0xC2 && byte < 0xE0)
        return {2, byte & 0x1F, 0x80};
    if (byte >= 0xE0 && byte < 0xF0)
        return {3, byte & 0x0F, 0x800};
    if (byte >= 0xF0 && byte < 0xF5)
        return {4, byte & 0x07, 0x10000};
    return {0, 0, 0};
}

} // namespace detail

// With surrogates allowed, the three-byte forms of lone surrogates are code points too.
constexpr CodePoint DecodePoint(const char* p, const char* end, bool areSurrogatesAllowed = false)
{
    const detail::Utf8Lead lead = detail::LeadOf(Unit(*p));
    if (lead.length == 0 || static_cast<std::uint32_t>(end - p > 4 ? 4 : end - p) < lead.length)
        return {};

    char32_t value = lead.bits;
    for (std::uint32_t i = 1; i < lead.length; ++i) {
        if ((Unit(p[i]) & 0xC0) != 0x80)
            return {};
        value = value << 6 | (Unit(p[i]) & 0x3F);
    }
    const bool isSurrogate = IsHighSurrogate(value) || IsLowSurrogate(value);
    if (value < lead.least || value > 0x10FFFF || (isSurrogate && !areSurrogatesAllowed))
        return {};
    return {value, lead.length};
}

// Writes a code point, and returns the place after it.
constexpr char16_t* PutPoint(char16_t* to, char32_t c)
{
    if (c >= 0x10000) {
        *to++ = static_cast<char16_t>(0xD800 + ((c - 0x10000) >> 10));
        c = 0xDC00 + ((c - 0x10000) & 0x3FF);
    }
    *to++ = static_cast<char16_t>(c);
    return to;
}

constexpr char* PutPoint(char* to, char32_t c)
{
    const auto put = [&to](char32_t unit) { *to++ = static_cast<char>(static_cast<unsigned char>(unit)); };
    if (c < 0x80) {
        put(c);
        return to;
    }
    if (c < 0x800) {
        put(0xC0 | c >> 6);
    } else if (c < 0x10000) {
        put(0xE0 | c >> 12);
        put(0x80 | (c >> 6 & 0x3F));
    } else {
        put(0xF0 | c >> 18);
        put(0x80 | (c >> 12 & 0x3F));
        put(0x80 | (c >> 6 & 0x3F));
    }
    put(0x80 | (c & 0x3F));
    return to;
}

template <class Char>
void AppendPoint(std::basic_string<Char>& to, char32_t c)
{
    Char units[4];
    to.append(units, PutPoint(units, c));
}

} // namespace varnex3::xml
