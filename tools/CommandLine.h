// The arguments of the program, and what they call.
#pragma once

#include "Status.h"
#include "Terminal.h"

namespace varnex3::tool {

// Runs one subcommand. What keeps it from running goes to the error stream.
Status Run(int argumentCount, const char* const* arguments, const Console& console);

} // namespace varnex3::tool
