#include "varnex3/quote/PartNumberDef.h"

namespace varnex3 {

VARNEX_DEFINE(PartNumberDef);

} // namespace varnex3
