// expect: Self
#include "varnex3/core/Rows.h"

namespace varnex3 {

class SampleDef final : public Record
{
#ifdef VARNEX3_CORRECT
    VARNEX_RECORD(SampleDef, "A sample.");
#endif
    VARNEX_PROPERTY(Text, sName, Name, "A name.");
    VARNEX_RECORD_END;
};
VARNEX_DEFINE(SampleDef);

} // namespace varnex3
