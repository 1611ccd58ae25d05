#include "varnex3/core/VersionDef.h"

namespace varnex3 {

VARNEX_DEFINE(VersionDef);

LibraryVersion& RunningVersion()
{
    static LibraryVersion version{VARNEX3_VERSION_MAJOR, VARNEX3_VERSION_MINOR};
    return version;
}

Text VersionDef::DLLVersion() const
{
    const LibraryVersion version = RunningVersion();
    return ToText(Variant(version.major)) + u"." + ToText(Variant(version.minor));
}

void VersionDef::Write(XmlWriter& xml) const
{
    xml.Open("Version");
    xml.Always("XaloVersion", sXaloVersion);
    xml.Close("Version");
}

void VersionDef::Read(const XmlSection& section) { sXaloVersion = section.TextAt("Version/XaloVersion"); }

} // namespace varnex3
