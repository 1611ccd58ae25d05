// Records filled with plausible values, by their rows and a table of texts.
#pragma once

#include "varnex3/core/Interface.h"

namespace varnex3::tool {

// A new record in which every property and list has a value, as one repair job might give it. The items of a list have
// one kind each, where there are kinds. The same class gives the same record.
Ref<Record> ExampleOf(const ClassInfo& info);

} // namespace varnex3::tool
