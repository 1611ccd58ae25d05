#include "varnex3/core/RepairerDef.h"

#include "varnex3/core/PartyFields.h"

namespace varnex3 {

VARNEX_DEFINE(RepairerDef);

void RepairerDef::Write(XmlWriter& xml) const
{
    const bool isWritten = IsSet(sRepairerID) || IsSet(sRepairerName); // further fields alone do not cause the group
    if (!isWritten)
        return;

    xml.Open("Repairer");
    xml.Always("RepairerID", sRepairerID);
    xml.Always("RepairerName", Escaped(sRepairerName));
    WriteFields(xml, "RepairerDetails", *objRepairerDetails);
    xml.Close("Repairer");
}

void RepairerDef::Read(const XmlSection& section)
{
    sRepairerID = section.RequiredTextAt("Repairer/RepairerID");
    sRepairerName = section.RequiredTextAt("Repairer/RepairerName");
    ReadFields(section, "RepairerDetails", *objRepairerDetails);
}

} // namespace varnex3
