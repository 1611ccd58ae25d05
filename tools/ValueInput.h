// A value from the standard input: what is typed there shows neither in the list of processes nor in a shell's history.
#pragma once

#include <string>

#include "Terminal.h"

namespace varnex3::tool {

// One line, without its end. At a terminal it is asked for, and what is typed is not shown when it is secret. Raises
// InvalidArgument when there is no line.
std::string ReadValue(bool isSecret, Terminal& prompt);

} // namespace varnex3::tool
