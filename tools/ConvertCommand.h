// varnex3 convert FILE: a message from XML to JSON, and back.
#pragma once

#include <string>

#include "Status.h"
#include "Terminal.h"

namespace varnex3::tool {

struct ConvertOptions
{
    std::string file;   // as the system has it
    std::string to;     // "json" or "xml"; empty for the one that the file is not
    std::string output; // a file's name; the standard output when it is empty
};

// A file that is no message, is broken, or has a value that its class cannot take is a finding, and nothing is written.
// Raises FileNotFound and the like when a file cannot be read or written.
Status Convert(const ConvertOptions& options, const Console& console);

} // namespace varnex3::tool
