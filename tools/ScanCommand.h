// varnex3 scan FOLDER: what an inbox holds, and what is wrong with it.
#pragma once

#include <string>

#include "Status.h"
#include "Terminal.h"

namespace varnex3::tool {

struct ScanOptions
{
    std::string folder;        // as the system has it
    std::string sort = "name"; // the key of a column
    bool isJson = false;
};

// Raises FolderMissing when there is no such folder.
Status Scan(const ScanOptions& options, const Console& console);

} // namespace varnex3::tool
