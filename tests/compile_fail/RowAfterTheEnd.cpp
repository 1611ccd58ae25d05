// expect: a row stands after the end of its class
#include "varnex3/core/Rows.h"

namespace varnex3 {

class SampleDef final : public Record
{
    VARNEX_RECORD(SampleDef, "A sample.");
    VARNEX_PROPERTY(Text, sFirst, First, "First.");
#ifdef VARNEX3_CORRECT
    VARNEX_PROPERTY(Text, sSecond, Second, "Second.");
    VARNEX_RECORD_END;
#else
    VARNEX_RECORD_END;
    VARNEX_PROPERTY(Text, sSecond, Second, "Second.");
#endif
};
VARNEX_DEFINE(SampleDef);

} // namespace varnex3
