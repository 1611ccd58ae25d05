// The machine and the process, as far as a report tells of them.
#pragma once

#include <string>

#include "varnex3/core/Text.h"

namespace varnex3::tool {

struct HostFacts
{
    std::string system; // its name, release and processor
    Text computerName;
    int bits;               // of this program, and so of the drivers it can load
    std::string locale;     // printable
    bool isLocaleInstalled; // C is in force when it is not
};

HostFacts ReadHostFacts();

} // namespace varnex3::tool
