#include "varnex3/outcomes/DeclinedDetailDef.h"

namespace varnex3 {

VARNEX_DEFINE(DeclinedDetailDef);

void DeclinedDetailDef::Write(XmlWriter& xml) const
{
    const bool isWritten = IsSet(dtDeclinedDate) && IsSet(sReasonText); // both together
    if (!isWritten)
        return;

    xml.Open("DeclinedDetail");
    xml.Always("DeclinedDate", dtDeclinedDate);
    xml.Always("ReasonText", sReasonText);
    xml.Close("DeclinedDetail");
}

} // namespace varnex3
