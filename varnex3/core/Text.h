// The text type: 16-bit Unicode everywhere inside; UTF-8 only at files, foreign callers and the command line.
#pragma once

#include <string>
#include <string_view>

#include "varnex3/xml/Unicode.h"

namespace varnex3 {

using Text = std::u16string;
using TextView = std::u16string_view;

// The name of an element, class or member: ASCII, known when the library is compiled. Names are narrow literals and
// values are u"..." literals, so that the two cannot be mistaken for each other.
using Name = std::string_view;

// A name as text.
inline Text ToText(Name name) { return {name.begin(), name.end()}; }

using xml::ToUtf16;
using xml::ToUtf8;

// Whether a character is a blank in a number, a date or a trimmed value: the space character alone.
constexpr bool IsBlank(char16_t c) { return c == u' '; }

// The text without leading and trailing blanks. Trimmed(u"  a b ") is u"a b".
constexpr TextView Trimmed(TextView text)
{
    while (!text.empty() && IsBlank(text.front()))
        text.remove_prefix(1);
    while (!text.empty() && IsBlank(text.back()))
        text.remove_suffix(1);
    return text;
}

// ASCII letters in lower case, everything else as it is.
constexpr char16_t ToLower(char16_t c) { return c >= u'A' && c <= u'Z' ? static_cast<char16_t>(c + 32) : c; }

// Letters of ASCII and Latin-1 in upper case, everything else as it is.
constexpr char16_t ToUpper(char16_t c)
{
    const bool isLower = (c >= u'a' && c <= u'z') || (c >= u'\u00E0' && c <= u'\u00FE' && c != u'\u00F7');
    if (isLower)
        return static_cast<char16_t>(c - 32);
    return c == u'\u00FF' ? u'\u0178' : c;
}
inline Text ToUpper(Text text)
{
    for (char16_t& c : text)
        c = ToUpper(c);
    return text;
}

// Whether two texts are equal but for the case of ASCII letters.
constexpr bool EqualsIgnoringCase(TextView a, TextView b)
{
    if (a.size() != b.size())
        return false;
    for (std::size_t i = 0; i < a.size(); ++i)
        if (ToLower(a[i]) != ToLower(b[i]))
            return false;
    return true;
}

} // namespace varnex3
