// expect: protected
#include "varnex3/core/Rows.h"

namespace varnex3 {

class SampleDef final : public Record
{
    VARNEX_RECORD(SampleDef, "A sample.");
    VARNEX_PROPERTY(Text, sName, Name, "A name.");
    VARNEX_RECORD_END;
};
VARNEX_DEFINE(SampleDef);

inline void Use()
{
#ifdef VARNEX3_CORRECT
    const auto sample = New<SampleDef>();
#else
    SampleDef sample;
#endif
    static_cast<void>(sample);
}

} // namespace varnex3
