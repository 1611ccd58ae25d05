// varnex3 new TYPE: an example of a message, filled, to test with.
#pragma once

#include <string>

#include "Status.h"
#include "Terminal.h"

namespace varnex3::tool {

struct NewOptions
{
    std::string type;   // the name of a message's class, with or without Xalo_, in any letter case
    std::string to;     // "json", or "xml", which is the default
    std::string output; // a file's name; the standard output when it is empty
};

// The same example every time. Raises InvalidArgument with the list of types when there is none of that name.
Status NewMessage(const NewOptions& options, const Console& console);

} // namespace varnex3::tool
