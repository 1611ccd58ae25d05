#include "varnex3/server/Slots.h"

namespace varnex3::server {

template std::span<const ClassVtable> VtablesOf(OutcomeClasses);

} // namespace varnex3::server
