// expect: a member has at most six parameters
#include "varnex3/core/Rows.h"

namespace varnex3 {

class SampleDef final : public Record
{
    VARNEX_RECORD(SampleDef, "A sample.");
#ifdef VARNEX3_CORRECT
    VARNEX_METHOD(void, Add, (bool a, bool b, bool c, bool d, bool e, bool f), "Adds.");
#else
    VARNEX_METHOD(void, Add, (bool a, bool b, bool c, bool d, bool e, bool f, bool g), "Adds.");
#endif
    VARNEX_RECORD_END;
};
VARNEX_DEFINE(SampleDef);

} // namespace varnex3
