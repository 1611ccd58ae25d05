// What an error report says was wrong, as a table.
#pragma once

#include "FactSheet.h"
#include "varnex3/notices/ErrorDetailsDef.h"

namespace varnex3::tool {

// A line an error: its severity in words where the workshop's database has them, its kind, what is wrong, and what the
// kind says beside. A detail of several kinds takes a line for each.
void PrintErrors(FactSheet& sheet, ErrorDetailsDef& errors);

} // namespace varnex3::tool
