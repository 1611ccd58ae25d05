// varnex3 identify FILE...: which message each file is, by its root tag alone.
#pragma once

#include <string>
#include <vector>

#include "Status.h"
#include "Terminal.h"

namespace varnex3::tool {

struct IdentifyOptions
{
    std::vector<std::string> files; // as the system has them
    bool isJson = false;
};

// A file that is no message, or that cannot be read, is a finding.
Status Identify(const IdentifyOptions& options, const Console& console);

} // namespace varnex3::tool
