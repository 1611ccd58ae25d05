// Text as a terminal shows it: made safe to print, measured in columns, cut and wrapped by them.
#pragma once

#include <cstddef>
#include <string>
#include <string_view>
#include <vector>

#include "varnex3/core/Text.h"

namespace varnex3::tool {

// What a terminal obeys instead of showing it: control characters, line separators, changes of writing direction.
bool IsControl(char32_t character);

// As UTF-8, without control characters: they come as \t, \r, \n or \u{1B}, a lone surrogate as U+FFFD.
std::string Printable(TextView text);

// The same for a text of one character.
std::string Printable(char32_t character);

// The columns that a printable text takes: East Asian wide characters two, combining ones none.
std::size_t DisplayWidth(std::string_view printable);

// Plural(2, "file") is "2 files".
std::string Plural(std::size_t count, const std::string& noun);

// At most that many columns: what is cut off is marked by an ellipsis. Cut("registration", 6) is "regis…".
std::string Cut(std::string_view printable, std::size_t width);

// Lines of at most that many columns, broken at blanks; a longer word is broken where the line ends. At least one.
std::vector<std::string> Wrapped(std::string_view printable, std::size_t width);

} // namespace varnex3::tool
