#include "varnex3/server/Slots.h"

namespace varnex3::server {

template std::span<const ClassVtable> VtablesOf(CoreClasses);

} // namespace varnex3::server
