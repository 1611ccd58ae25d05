// The root tag of a file, found without reading the rest of it.
#pragma once

#include "varnex3/core/Text.h"

namespace varnex3::tool {

// What the beginning of a file says. Nothing behind the root tag's name is looked at: the file may still be broken.
struct RootTag
{
    Text name;   // of the root element; empty when there is none
    Text reason; // why there is none: a sentence without a full stop
};

// Reads a file from its start, only as far as it takes: 4 KiB as a rule. Throws std::system_error when it cannot be
// read.
RootTag ReadRootTag(TextView path);

} // namespace varnex3::tool
