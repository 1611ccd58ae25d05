// expect: a row stands after the end of its class
#include "varnex3/core/Rows.h"

namespace varnex3 {

VARNEX_MODULE(modSample, "A sample.");
VARNEX_FUNCTION(modSample, Text, First, (const Text& sText), "First.");
#ifdef VARNEX3_CORRECT
VARNEX_FUNCTION(modSample, Text, Second, (const Text& sText), "Second.");
VARNEX_MODULE_END(modSample);
#else
VARNEX_MODULE_END(modSample);
VARNEX_FUNCTION(modSample, Text, Second, (const Text& sText), "Second.");
#endif
VARNEX_MODULE_DEFINE(modSample);

} // namespace varnex3
