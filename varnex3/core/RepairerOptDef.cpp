#include "varnex3/core/RepairerOptDef.h"

#include "varnex3/core/PartyFields.h"

namespace varnex3 {

VARNEX_DEFINE(RepairerOptDef);

void RepairerOptDef::Write(XmlWriter& xml) const
{
    xml.Open("Repairer");
    xml.Always("RepairerID", sRepairerID);
    xml.Always("RepairerName", sRepairerName); // not escaped here
    WriteFields(xml, "RepairerDetails", *objRepairerDetails);
    xml.Close("Repairer");
}

void RepairerOptDef::Read(const XmlSection& section)
{
    sRepairerID = section.RequiredTextAt("Repairer/RepairerID");
    sRepairerName = section.RequiredTextAt("Repairer/RepairerName");
    ReadFields(section, "RepairerDetails", *objRepairerDetails);
}

} // namespace varnex3
