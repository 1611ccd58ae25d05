// The bytes of a message file as characters, well-formed or not: what an editor would show.
#pragma once

#include <string_view>

#include "varnex3/core/Text.h"

namespace varnex3::tool {

// Bytes that are no characters of the file's encoding come as U+FFFD; an encoding that the library does not know is
// taken for ISO-8859-1. The byte order mark is left out.
Text DecodeFileText(std::string_view bytes);

} // namespace varnex3::tool
