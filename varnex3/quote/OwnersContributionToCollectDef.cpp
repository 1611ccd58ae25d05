#include "varnex3/quote/OwnersContributionToCollectDef.h"

namespace varnex3 {

VARNEX_DEFINE(OwnersContributionToCollectDef);

void OwnersContributionToCollectDef::Write(XmlWriter& xml) const
{
    const bool isWritten = IsSet(sReason) && dValue > 0; // both together
    if (!isWritten)
        return;

    xml.Open("OwnersContributionToCollect");
    xml.Always("Value", dValue);
    xml.Always("Reason", sReason);
    xml.Close("OwnersContributionToCollect");
}

void OwnersContributionToCollectDef::Read(const XmlSection& section)
{
    dValue = section.NumberAt("OwnersContributionToCollect/Value");
    sReason = section.TextAt("OwnersContributionToCollect/Reason");
}

} // namespace varnex3
