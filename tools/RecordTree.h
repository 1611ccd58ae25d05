// A record as a tree of names and values.
#pragma once

#include <cstddef>
#include <string_view>

#include "Terminal.h"
#include "varnex3/core/Interface.h"

namespace varnex3::tool {

// A name, and its value where all values stand below each other; a longer value goes on below itself. An empty value
// shows as a hyphen.
void PrintField(Terminal& terminal, std::size_t depth, std::string_view name, std::string_view value);

// The name of what stands one step further in.
void PrintGroup(Terminal& terminal, std::size_t depth, std::string_view name);

// Every property of a record in interface order, those of its children one step further in. The members of a list of
// named fields are its fields.
void PrintRecord(Terminal& terminal, std::size_t depth, Record& record);

} // namespace varnex3::tool
