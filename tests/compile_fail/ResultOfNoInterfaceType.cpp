// expect: a result is a text, number, date, Boolean, enumeration, record or variant
#include "varnex3/core/Rows.h"

namespace varnex3 {

class SampleDef final : public Record
{
    VARNEX_RECORD(SampleDef, "A sample.");
#ifdef VARNEX3_CORRECT
    VARNEX_METHOD(std::int32_t, Total, (), "A total.");
#else
    VARNEX_METHOD(std::uint64_t, Total, (), "A total.");
#endif
    VARNEX_RECORD_END;
};
VARNEX_DEFINE(SampleDef);

} // namespace varnex3
