// From text as it is written, which the parser has checked, to the text that is meant: references and line ends
// resolved.
#pragma once

#include <string>
#include <string_view>

#include "varnex3/xml/Document.h"
#include "varnex3/xml/Unicode.h"

namespace varnex3::xml {

inline void AppendPlain(std::u16string& to, std::u16string_view text) { to.append(text); }
inline void AppendPlain(std::u16string& to, std::string_view text) { AppendUtf16(to, text); }

// The content of a node: references count in an element and a text, line ends everywhere.
template <class Char>
void AppendContent(std::u16string& to, std::basic_string_view<Char> raw, NodeType type);

// An attribute's value: references resolved, each white space character a blank.
template <class Char>
void AppendAttributeValue(std::u16string& to, std::basic_string_view<Char> raw);

// A checked reference, from its "&" on.
struct Reference
{
    char32_t character; // 0 for an entity that is not predefined
    std::size_t length; // "&" and ";" included
};

// What a reference stands for. Precondition: it is well-formed, up to its ";".
template <class Char>
Reference ReadReference(std::basic_string_view<Char> from);

} // namespace varnex3::xml
