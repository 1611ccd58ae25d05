// expect: the member of a property is named by its type's prefix and the property's name
#include "varnex3/core/Rows.h"

namespace varnex3 {

class SampleDef final : public Record
{
    VARNEX_RECORD(SampleDef, "A sample.");
#ifdef VARNEX3_CORRECT
    VARNEX_PROPERTY(double, dAmount, Amount, "An amount.");
#else
    VARNEX_PROPERTY(double, sAmount, Amount, "An amount.");
#endif
    VARNEX_RECORD_END;
};
VARNEX_DEFINE(SampleDef);

} // namespace varnex3
