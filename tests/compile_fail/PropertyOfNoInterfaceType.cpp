// expect: a property is a text, number, date, Boolean, enumeration or record
#include "varnex3/core/Rows.h"

namespace varnex3 {

class SampleDef final : public Record
{
    VARNEX_RECORD(SampleDef, "A sample.");
#ifdef VARNEX3_CORRECT
    VARNEX_READONLY(Text, Name, "A name.");
#else
    VARNEX_READONLY(std::string, Name, "A name.");
#endif
    VARNEX_RECORD_END;
};
VARNEX_DEFINE(SampleDef);

} // namespace varnex3
