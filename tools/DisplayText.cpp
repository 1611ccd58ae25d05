#include "DisplayText.h"

#include <algorithm>
#include <clocale>
#include <cwchar>
#include <initializer_list>

#include "varnex3/xml/Characters.h"

namespace varnex3::tool {

namespace {

constexpr char32_t kReplacement = 0xFFFD;

bool IsDirectionOrSeparator(char32_t c)
{
    return c == 0x061C || c == 0x200E || c == 0x200F || (c >= 0x2028 && c <= 0x202E) || (c >= 0x2066 && c <= 0x2069);
}

// The system measures characters in the locale of the process, which says nothing about our UTF-8.
bool HasUnicodeLocale()
{
    static const bool isSet =
        std::ranges::any_of(std::initializer_list<const char*>{"C.UTF-8", "C.utf8", "en_US.UTF-8"},
                            [](const char* locale) { return std::setlocale(LC_CTYPE, locale) != nullptr; });
    return isSet;
}

// Negative for what cannot be shown.
int WidthOf(char32_t c)
{
    if (IsControl(c))
        return -1;
    return HasUnicodeLocale() ? wcwidth(static_cast<wchar_t>(c)) : 1;
}

std::string EscapeOf(char32_t c)
{
    switch (c) {
    case U'\t':
        return "\\t";
    case U'\n':
        return "\\n";
    case U'\r':
        return "\\r";
    default:
        break;
    }
    std::string digits;
    for (; c != 0 || digits.empty(); c >>= 4)
        digits.insert(digits.begin(), "0123456789ABCDEF"[c & 0xF]);
    return "\\u{" + digits + "}";
}

// Calls an action with each character's bytes and its width.
template <class Action>
void ForEachCharacter(std::string_view printable, Action action)
{
    const char* const end = printable.data() + printable.size();
    for (const char* p = printable.data(); p < end;) {
        const xml::CodePoint point = xml::DecodePoint(p, end);
        const std::size_t length = std::max(point.length, std::uint32_t{1});
        const int width = point.length == 0 ? 1 : WidthOf(point.value);
        action(std::string_view(p, length), static_cast<std::size_t>(std::max(width, 0)));
        p += length;
    }
}

// The bytes of as many characters as fit.
std::size_t FittingLength(std::string_view printable, std::size_t width)
{
    std::size_t length = 0;
    std::size_t used = 0;
    bool isFull = false;
    ForEachCharacter(printable, [&](std::string_view character, std::size_t columns) {
        used += columns;
        isFull = isFull || used > width;
        length += isFull ? 0 : character.size();
    });
    return length;
}

// Where a line of a wrapped text ends: behind its last whole word, or within a word that is longer than the line.
std::size_t LineLength(std::string_view text, std::size_t width)
{
    const std::size_t fitting = FittingLength(text, width);
    if (fitting == text.size() || text[fitting] == ' ')
        return fitting;
    const std::size_t blank = text.substr(0, fitting).rfind(' ');
    if (blank != std::string_view::npos && blank > 0)
        return blank;
    return fitting > 0 ? fitting : 1; // a character wider than the line must go somewhere
}

} // namespace

bool IsControl(char32_t c) { return c < 0x20 || (c >= 0x7F && c < 0xA0) || IsDirectionOrSeparator(c); }

std::string Printable(char32_t character)
{
    if (WidthOf(character) < 0)
        return EscapeOf(character);
    std::string text;
    xml::AppendPoint(text, character);
    return text;
}

std::string Printable(TextView text)
{
    std::string printable;
    const char16_t* const end = text.data() + text.size();
    for (const char16_t* p = text.data(); p < end;) {
        const xml::CodePoint point = xml::DecodePoint(p, end);
        printable += Printable(point.length == 0 ? kReplacement : point.value);
        p += std::max(point.length, std::uint32_t{1});
    }
    return printable;
}

std::size_t DisplayWidth(std::string_view printable)
{
    std::size_t width = 0;
    ForEachCharacter(printable, [&](std::string_view, std::size_t columns) { width += columns; });
    return width;
}

std::string Plural(std::size_t count, const std::string& noun)
{
    return std::to_string(count) + " " + noun + (count == 1 ? "" : "s");
}

std::string Cut(std::string_view printable, std::size_t width)
{
    if (DisplayWidth(printable) <= width)
        return std::string(printable);
    if (width == 0)
        return {};
    return std::string(printable.substr(0, FittingLength(printable, width - 1))) + "…";
}

std::vector<std::string> Wrapped(std::string_view printable, std::size_t width)
{
    std::vector<std::string> lines;
    do {
        const std::size_t length = LineLength(printable, width);
        lines.emplace_back(printable.substr(0, length));
        printable.remove_prefix(length);
        printable.remove_prefix(std::min(printable.find_first_not_of(' '), printable.size()));
    } while (!printable.empty());
    return lines;
}

} // namespace varnex3::tool
