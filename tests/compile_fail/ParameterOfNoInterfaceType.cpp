// expect: a parameter is a text, number, date, Boolean, enumeration, record or variant
#include "varnex3/core/Rows.h"

namespace varnex3 {

class SampleDef final : public Record
{
    VARNEX_RECORD(SampleDef, "A sample.");
#ifdef VARNEX3_CORRECT
    VARNEX_METHOD(void, Add, (const Text& sName), "Adds.");
#else
    VARNEX_METHOD(void, Add, (const char* sName), "Adds.");
#endif
    VARNEX_RECORD_END;
};
VARNEX_DEFINE(SampleDef);

} // namespace varnex3
