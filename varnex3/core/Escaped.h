// A text in which the characters of markup become entities, for a writer that has room for it already.
#pragma once

#include <algorithm>

#include "varnex3/core/Text.h"

namespace varnex3 {

// & < > ' and the double quote become entities; an entity in the text is escaped once more. The text is looked at, not
// kept.
class Escaped
{
public:
    explicit constexpr Escaped(TextView value) : text(value) {}

    // How many characters it has when written.
    constexpr std::size_t Length() const
    {
        std::size_t length = text.size();
        for (const char16_t c : text)
            length += IsMarkup(c) ? EntityOf(c).size() - 1 : 0;
        return length;
    }

    // Gives the place behind the last character. Precondition: room for Length() characters.
    constexpr char16_t* Put(char16_t* to) const
    {
        for (const char16_t c : text) {
            if (IsMarkup(c))
                to = std::ranges::copy(EntityOf(c), to).out;
            else
                *to++ = c;
        }
        return to;
    }

    constexpr bool IsEmpty() const { return text.empty(); }

private:
    static constexpr bool IsMarkup(char16_t c)
    {
        return c == u'&' || c == u'<' || c == u'>' || c == u'\'' || c == u'"';
    }

    static constexpr TextView EntityOf(char16_t c)
    {
        switch (c) {
        case u'&':
            return u"&amp;";
        case u'<':
            return u"&lt;";
        case u'>':
            return u"&gt;";
        case u'\'':
            return u"&apos;";
        default:
            return u"&quot;";
        }
    }

    TextView text;
};

constexpr bool IsSet(Escaped text) { return !text.IsEmpty(); }

} // namespace varnex3
