// The line of a file where something is wrong, as a person is shown it.
#pragma once

#include <cstddef>
#include <string>
#include <string_view>

#include "varnex3/xml/ParseError.h"

namespace varnex3::tool {

struct SourceExcerpt
{
    std::string text;      // printable; cut on both sides where the line is longer than the width
    std::size_t caret = 0; // how many columns stand before the place
};

// TABs count and show as one blank.
SourceExcerpt ExcerptAt(std::string_view bytes, const xml::ParseError& place, std::size_t width);

} // namespace varnex3::tool
