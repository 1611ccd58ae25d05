#include "varnex3/core/DestinationDef.h"

namespace varnex3 {

VARNEX_DEFINE(DestinationDef);

void DestinationDef::Write(XmlWriter& xml) const
{
    xml.Open("Destination");
    xml.Always("OrgType", sOrgType);
    xml.Close("Destination");
}

void DestinationDef::Read(const XmlSection& section) { sOrgType = section.RequiredTextAt("Destination/OrgType"); }

} // namespace varnex3
