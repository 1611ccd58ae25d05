#include "varnex3/quote/InspectionDef.h"

#include "varnex3/quote/OneLine.h"

namespace varnex3 {

VARNEX_DEFINE(InspectionDef);

void InspectionDef::Write(XmlWriter& xml) const
{
    if (!IsSet(sInspectionReason))
        return;

    xml.Line("<InspectionReqested InspectionReason='", Escaped(OnOneLine(sInspectionReason)),
             "'></InspectionReqested>");
}

void InspectionDef::Read(const XmlSection& section)
{
    sInspectionReason = section.TextAt("InspectionReqested/InspectionReason"); // not the attribute that Write writes
}

} // namespace varnex3
