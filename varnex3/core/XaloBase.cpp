#include "varnex3/core/XaloBase.h"

namespace varnex3 {

VARNEX_DEFINE(XaloBase);

} // namespace varnex3
