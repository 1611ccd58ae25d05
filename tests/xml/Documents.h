// What the tests of the XML engine share: documents that must load, and texts shown so that white space can be seen.
#pragma once

#include <string>
#include <string_view>

#include <doctest/doctest.h>

#include "varnex3/xml/Document.h"
#include "varnex3/xml/Unicode.h"

namespace varnex3::xml {

inline std::string Shown(std::u16string_view text)
{
    std::string shown;
    for (const char c : ToUtf8(text))
        shown += c == '\r' ? "<CR>" : c == '\n' ? "<LF>" : c == '\t' ? "<TAB>" : std::string(1, c);
    return shown;
}

inline Document Loaded(std::u16string_view text)
{
    Document document;
    INFO(Shown(text));
    REQUIRE_MESSAGE(document.LoadText(text), ToUtf8(document.Error().reason));
    return document;
}

inline Document LoadedBytes(std::string_view bytes)
{
    Document document;
    REQUIRE_MESSAGE(document.LoadBytes(bytes), ToUtf8(document.Error().reason));
    return document;
}

// The text of the root element.
inline std::u16string TextOf(std::u16string_view text) { return Loaded(text).Root().Text(); }

} // namespace varnex3::xml

namespace doctest {

template <>
struct StringMaker<std::u16string>
{
    static String convert(const std::u16string& text) { return varnex3::xml::Shown(text).c_str(); }
};

} // namespace doctest
