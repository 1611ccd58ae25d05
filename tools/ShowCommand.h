// varnex3 show FILE: what one message says, or where it is broken.
#pragma once

#include <string>

#include "Status.h"
#include "Terminal.h"

namespace varnex3::tool {

struct ShowOptions
{
    std::string file; // as the system has it
    bool isJson = false;
};

// Raises FileNotFound and the like when the file cannot be read.
Status Show(const ShowOptions& options, const Console& console);

} // namespace varnex3::tool
