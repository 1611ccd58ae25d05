// expect: two members have the same name but for the case of letters
#include "varnex3/core/Rows.h"

namespace varnex3 {

class SampleDef final : public Record
{
    VARNEX_RECORD(SampleDef, "A sample.");
    VARNEX_PROPERTY(Text, sFullName, FullName, "A name.");
#ifdef VARNEX3_CORRECT
    VARNEX_PROPERTY(Text, sFullNames, FullNames, "Names.");
#else
    VARNEX_PROPERTY(Text, sFullname, Fullname, "A name.");
#endif
    VARNEX_RECORD_END;
};
VARNEX_DEFINE(SampleDef);

} // namespace varnex3
