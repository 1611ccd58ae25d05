// The loops that look at every character: how far a run of plain ones goes. The text must be followed by `padding`
// zeros: they end every run.
//
// Texts differ in length, so they are searched sixteen characters at a time where the processor has SSE2. Names and
// white space repeat themselves: the processor foresees a plain loop over them and need not wait for its outcome, which
// measured a fifth faster than blocks.
#pragma once

#include <array>
#include <bit>
#include <cstddef>
#include <cstdint>
#include <cstring>

#include "varnex3/xml/Characters.h"

#if defined(__SSE2__) && !defined(VARNEX3_XML_SCALAR)
#define VARNEX3_XML_SSE2
#include <emmintrin.h>
#endif

namespace varnex3::xml {

// Zeros after a text: a block that starts at its end, and what the parser looks ahead.
inline constexpr std::size_t padding = 32;

namespace detail {

#ifdef VARNEX3_XML_SSE2

// ---- sixteen characters at a time

inline constexpr int blockSize = 16;

inline __m128i LoadBlock(const void* p) { return _mm_loadu_si128(static_cast<const __m128i*>(p)); }
inline __m128i LoadCharacters(const char* p) { return LoadBlock(p); }

// Sixteen characters as bytes. Those beyond U+00FF become 0xFF or 0, which are in no class of plain characters.
inline __m128i LoadCharacters(const char16_t* p) { return _mm_packus_epi16(LoadBlock(p), LoadBlock(p + 8)); }

inline __m128i Equal(__m128i block, char c) { return _mm_cmpeq_epi8(block, _mm_set1_epi8(c)); }

inline __m128i AtMost(__m128i block, char limit)
{
    return _mm_cmpeq_epi8(_mm_min_epu8(block, _mm_set1_epi8(limit)), block);
}

template <class... Blocks>
__m128i AnyOf(__m128i first, Blocks... others)
{
    ((first = _mm_or_si128(first, others)), ...);
    return first;
}

// Sixteen characters to another width, when all are ASCII.
inline bool CopyAsciiBlock(const char* from, char16_t* to)
{
    const __m128i block = LoadBlock(from);
    if (_mm_movemask_epi8(block) != 0)
        return false;
    _mm_storeu_si128(reinterpret_cast<__m128i*>(to), _mm_unpacklo_epi8(block, _mm_setzero_si128()));
    _mm_storeu_si128(reinterpret_cast<__m128i*>(to + 8), _mm_unpackhi_epi8(block, _mm_setzero_si128()));
    return true;
}

inline bool CopyAsciiBlock(const char16_t* from, char* to)
{
    const __m128i first = LoadBlock(from);
    const __m128i second = LoadBlock(from + 8);
    const __m128i beyondAscii = _mm_and_si128(_mm_or_si128(first, second), _mm_set1_epi16(static_cast<short>(0xFF80)));
    if (_mm_movemask_epi8(_mm_cmpeq_epi16(beyondAscii, _mm_setzero_si128())) != 0xFFFF)
        return false;
    _mm_storeu_si128(reinterpret_cast<__m128i*>(to), _mm_packus_epi16(first, second));
    return true;
}

inline __m128i LoadHalf(const void* p) { return _mm_loadl_epi64(static_cast<const __m128i*>(p)); }

inline __m128i LoadQuarter(const char* p)
{
    int four = 0;
    std::memcpy(&four, p, sizeof(four));
    return _mm_cvtsi32_si128(four);
}

// Compares characters of two widths, block by block, with one outcome at the end.
class AsciiComparison
{
public:
    void Eight(const char16_t* wide, const char* ascii) { Add(LoadBlock(wide), LoadHalf(ascii)); }
    void Four(const char16_t* wide, const char* ascii) { Add(LoadHalf(wide), LoadQuarter(ascii)); }

    bool IsSameAscii() const { return _mm_movemask_epi8(same) == 0xFFFF && _mm_movemask_epi8(narrows) == 0; }

private:
    void Add(__m128i wide, __m128i narrow)
    {
        same = _mm_and_si128(same, _mm_cmpeq_epi16(wide, _mm_unpacklo_epi8(narrow, _mm_setzero_si128())));
        narrows = _mm_or_si128(narrows, narrow);
    }

    __m128i same = _mm_set1_epi8(-1);
    __m128i narrows = _mm_setzero_si128();
};

// One bit for each of the sixteen characters that is in the class.
inline std::uint32_t Bits(__m128i isInClass) { return static_cast<std::uint32_t>(_mm_movemask_epi8(isInClass)); }

// Where the first block with a stop has it.
template <class Char, class Stops>
[[gnu::always_inline]] inline const Char* FindStop(const Char* p, Stops stops)
{
    for (;; p += blockSize)
        if (const std::uint32_t bits = stops(LoadCharacters(p)); bits != 0)
            return p + std::countr_zero(bits);
}

#endif

// ---- one character at a time

enum CharacterClass : std::uint8_t
{
    PlainInText = 1,
    PlainInValue = 2,
    InName = 4,
    Blank = 8
};

constexpr std::uint8_t ClassesOf(char c)
{
    const bool isPrintable = c >= 0x20;
    const bool isMarkup = c == '<' || c == '&';
    const bool isQuote = c == '"' || c == '\'';
    const bool isInName = IsAsciiLetter(c) || IsDigit(c) || c == '-' || c == '.' || c == '_';
    return static_cast<std::uint8_t>((isPrintable && !isMarkup && c != ']' ? PlainInText : 0)
                                     | (isPrintable && !isMarkup && !isQuote ? PlainInValue : 0)
                                     | (isInName ? InName : 0) | (IsBlank(c) ? Blank : 0));
}

inline constexpr auto classTable = [] {
    std::array<std::uint8_t, 256> table{};
    for (std::size_t c = 0; c < 128; ++c)
        table[c] = ClassesOf(static_cast<char>(c));
    return table;
}();

template <class Char>
[[gnu::always_inline]] inline const Char* SkipClass(const Char* p, CharacterClass wanted)
{
    while (Unit(*p) < classTable.size() && (classTable[Unit(*p)] & wanted) != 0)
        ++p;
    return p;
}

} // namespace detail

// The first character that is "<", "&", "]", below U+0020 or beyond ASCII.
template <class Char>
[[gnu::always_inline]] inline const Char* SkipPlainText(const Char* p)
{
#ifdef VARNEX3_XML_SSE2
    using namespace detail;
    return FindStop(p, [](__m128i b) {
        return Bits(AnyOf(b, Equal(b, '<'), Equal(b, '&'), Equal(b, ']'), AtMost(b, 0x1F))); // b itself: beyond ASCII
    });
#else
    return detail::SkipClass(p, detail::PlainInText);
#endif
}

// The first character that is "<", "&", the quote, below U+0020 or beyond ASCII; perhaps the other quote.
template <class Char>
[[gnu::always_inline]] inline const Char* SkipPlainValue(const Char* p, [[maybe_unused]] Char quote)
{
#ifdef VARNEX3_XML_SSE2
    using namespace detail;
    return FindStop(p, [quote](__m128i b) {
        return Bits(AnyOf(b, Equal(b, '<'), Equal(b, '&'), Equal(b, static_cast<char>(quote)), AtMost(b, 0x1F)));
    });
#else
    return detail::SkipClass(p, detail::PlainInValue);
#endif
}

// The first character that is no ASCII letter, digit, "-", "." or "_".
template <class Char>
[[gnu::always_inline]] inline const Char* SkipNameCharacters(const Char* p)
{
    return detail::SkipClass(p, detail::InName);
}

// The first character that is not white space. Most white space is a line end and TABs.
template <class Char>
[[gnu::always_inline]] inline const Char* SkipBlanks(const Char* p)
{
    if (*p == '\r' && p[1] == '\n')
        p += 2;
    while (*p == '\t')
        ++p;
    while (IsBlank(*p))
        ++p;
    return p;
}

// Whether a padded text goes on with the `count` characters of a name.
template <class Char>
[[gnu::always_inline]] inline bool SameCharacters(const Char* left, const Char* right, std::size_t count)
{
#ifdef VARNEX3_XML_SSE2
    using namespace detail;
    constexpr std::size_t perBlock = blockSize / sizeof(Char);
    for (; count > perBlock; left += perBlock, right += perBlock, count -= perBlock)
        if (Bits(_mm_cmpeq_epi8(LoadBlock(left), LoadBlock(right))) != 0xFFFFu)
            return false;
    const std::uint32_t wanted = (1u << (count * sizeof(Char))) - 1;
    return (~Bits(_mm_cmpeq_epi8(LoadBlock(left), LoadBlock(right))) & wanted) == 0;
#else
    for (; count != 0 && *left == *right; ++left, ++right) // not memcmp: that may read past the zeros
        --count;
    return count == 0;
#endif
}

// Whether characters are those of an ASCII text, as many of them; false, too, where that text is not ASCII. Most names
// have four characters and more: the blocks at their end overlap those before.
inline bool SameAscii(const char16_t* wide, const char* ascii, std::size_t count)
{
    std::size_t i = 0;
#ifdef VARNEX3_XML_SSE2
    detail::AsciiComparison comparison;
    if (count >= 8) {
        for (; i + 8 < count; i += 8)
            comparison.Eight(wide + i, ascii + i);
        comparison.Eight(wide + count - 8, ascii + count - 8);
        return comparison.IsSameAscii();
    }
    if (count >= 4) {
        comparison.Four(wide, ascii);
        comparison.Four(wide + count - 4, ascii + count - 4);
        return comparison.IsSameAscii();
    }
#endif
    while (i < count && wide[i] == Unit(ascii[i]) && Unit(ascii[i]) < 0x80)
        ++i;
    return i == count;
}

} // namespace varnex3::xml
