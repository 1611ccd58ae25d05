// From a text to its tree, in one pass.
#pragma once

#include "varnex3/xml/ParseError.h"
#include "varnex3/xml/Tree.h"

namespace varnex3::xml {

// Parses the text from this offset on, behind a byte order mark. The tree is of use only without an error.
template <class Char>
ParseError Parse(TextBuffer<Char> text, std::size_t offset, Tree<Char>& into);

} // namespace varnex3::xml
