#include "varnex3/notices/VersionChangeDef.h"

namespace varnex3 {

VARNEX_DEFINE(VersionChangeDef);

void VersionChangeDef::Write(XmlWriter& xml) const
{
    if (!IsSet(sXaloVersion) && !IsSet(sVarnexVersion) && !IsSet(sNextVarnexVersion))
        return;

    xml.Open("Version");
    xml.IfSet("XaloVersion", sXaloVersion);
    xml.IfSet("VarnexVersion", sVarnexVersion);
    xml.IfSet("NextVarnexVersion", sNextVarnexVersion);
    xml.Close("Version");
}

void VersionChangeDef::Read(const XmlSection& section)
{
    sXaloVersion = section.TextAt("Version/XaloVersion");
    sVarnexVersion = section.TextAt("Version/VarnexVersion");
    sNextVarnexVersion = section.TextAt("Version/NextVarnexVersion");
}

} // namespace varnex3
