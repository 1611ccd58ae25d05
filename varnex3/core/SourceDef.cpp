#include "varnex3/core/SourceDef.h"

#include "varnex3/core/modFunctions.h"

namespace varnex3 {

VARNEX_DEFINE(SourceDef);

void SourceDef::Write(XmlWriter& xml) const
{
    xml.Open("Source");
    xml.Always("OrgType", sOrgType);
    xml.Always("AppVersion", sAppVersion);
    xml.Always("AppName", sAppName);
    xml.Always("TimeStamp", DateText(dtTimeStamp, 1).View()); // the zero date, too
    xml.Close("Source");
}

void SourceDef::Read(const XmlSection& section)
{
    sOrgType = section.RequiredTextAt("Source/OrgType");
    sAppVersion = section.RequiredTextAt("Source/AppVersion");
    sAppName = section.RequiredTextAt("Source/AppName");
    dtTimeStamp = section.RequiredTimestampAt("Source/TimeStamp");
}

} // namespace varnex3
