#include "varnex3/core/InsurerOptDef.h"

#include "varnex3/core/PartyFields.h"

namespace varnex3 {

VARNEX_DEFINE(InsurerOptDef);

void InsurerOptDef::Write(XmlWriter& xml) const
{
    xml.Open("Insurer");
    xml.Always("UnderwriterName", sUnderwriterName);
    WriteFields(xml, "InsurerDetail", *objInsurerDetail);
    xml.Close("Insurer");
}

} // namespace varnex3
