// expect: the member of a property is named by its type's prefix and the property's name
#include "varnex3/core/Rows.h"

namespace varnex3 {

class SampleDef final : public Record
{
    VARNEX_RECORD(SampleDef, "A sample.");
    VARNEX_PROPERTY(Text, sQuoteNo, QuoteNo, "Quote number.");
#ifdef VARNEX3_CORRECT
    VARNEX_PROPERTY(Text, sMessageNo, MessageNo, "Message number.");
#else
    VARNEX_PROPERTY(Text, sMessageNumber, MessageNo, "Message number.");
#endif
    VARNEX_RECORD_END;
};
VARNEX_DEFINE(SampleDef);

} // namespace varnex3
