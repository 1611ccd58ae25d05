// expect: cannot be overloaded | class member cannot be redeclared
#include "varnex3/core/Rows.h"

namespace varnex3 {

// clang-format off
class SampleDef final : public Record
{
    VARNEX_RECORD(SampleDef, "A sample.");
#ifdef VARNEX3_CORRECT
    VARNEX_PROPERTY(Text, sFirst, First, "First.");
    VARNEX_PROPERTY(Text, sSecond, Second, "Second.");
#else
    VARNEX_PROPERTY(Text, sFirst, First, "First."); VARNEX_PROPERTY(Text, sSecond, Second, "Second.");
#endif
    VARNEX_RECORD_END;
};
// clang-format on
VARNEX_DEFINE(SampleDef);

} // namespace varnex3
