#include "varnex3/core/InsurerDef.h"

#include "varnex3/core/PartyFields.h"

namespace varnex3 {

VARNEX_DEFINE(InsurerDef);

void InsurerDef::Write(XmlWriter& xml) const
{
    if (!IsSet(sUnderwriterName)) // further fields alone do not cause the group
        return;

    xml.Open("Insurer");
    xml.Always("UnderwriterName", sUnderwriterName);
    WriteSetFields(xml, "InsurerDetail", *objInsurerDetail); // unlike the other parties, without the empty ones
    xml.Close("Insurer");
}

void InsurerDef::Read(const XmlSection& section)
{
    sUnderwriterName = section.RequiredTextAt("Insurer/UnderwriterName");
    ReadFields(section, "InsurerDetail", *objInsurerDetail);
}

} // namespace varnex3
