// The properties of a record as facts, by its rows.
#pragma once

#include "FactSheet.h"
#include "varnex3/core/Interface.h"

namespace varnex3::tool {

// What a person calls a property; its own name where nobody has found a better one.
Name LabelOf(Name property);

// Every property that is a single value, in interface order: an amount as an amount, a flag as "yes"; what has no
// value is left out.
void PrintProperties(FactSheet& sheet, Record& record);

} // namespace varnex3::tool
