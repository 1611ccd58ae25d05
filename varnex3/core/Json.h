// Any record as JSON.
#pragma once

#include <string>

#include "varnex3/core/Record.h"

namespace varnex3 {

// The properties of a record in interface order, as one JSON object on one line, UTF-8. Texts are strings, dates
// "yyyy-mm-ddThh:mm:ss", enumerations the name of their constant (the number when there is none), children objects or
// null. An indexed property of a class that has a Count is an array of its items. A lone surrogate, which UTF-8
// cannot carry, becomes U+FFFD; a number that is not finite null.
std::string ToJson(Record& record);

} // namespace varnex3
