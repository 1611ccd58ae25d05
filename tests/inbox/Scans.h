// A scan of a folder, as a host runs it.
#pragma once

#include <string>

#include "tests/Printing.h"
#include "varnex3/inbox/Xalo_Messages.h"

namespace varnex3::tests {

// How a scan ended: "fine", or the error's number.
inline std::string Scan(Xalo_Messages& messages, const Text& folder)
{
    std::int32_t number = 0;
    Text description;
    if (messages.ParseFiles(folder, &number, &description))
        return "fine";
    CHECK(description != u"");
    return std::to_string(number);
}

} // namespace varnex3::tests
