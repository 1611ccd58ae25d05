// Elements of a file as a tree, a line an element or attribute.
#pragma once

#include <cstddef>
#include <optional>
#include <vector>

#include "varnex3/core/Interface.h"
#include "varnex3/xml/Document.h"

namespace varnex3::tool {

struct ElementLine
{
    std::size_t depth;        // 0 for where the tree begins
    Text name;                // of an attribute behind @
    std::optional<Text> text; // none of an element with elements inside
};

// The node or the first element among those behind it; absent when there is none.
xml::Node FirstElementFrom(xml::Node node);

// The element and all below it.
std::vector<ElementLine> LinesOf(const xml::Node& element);

// Of those lines the ones that a class does not read, and what they stand in. A class knows the elements that are
// called like its properties and their constants, and like those of the records in it.
std::vector<ElementLine> UnknownLinesOf(const xml::Node& element, const ClassInfo& info);

} // namespace varnex3::tool
