#include "varnex3/notices/VarnexReferenceDataEnum.h"

namespace varnex3 {

VARNEX_DEFINE(VarnexReferenceDataEnum);

} // namespace varnex3
