#include "varnex3/core/VersionDef.h"

namespace varnex3 {

VARNEX_DEFINE(VersionDef);

Text VersionDef::DLLVersion() const
{
    constexpr std::int16_t major = VARNEX3_VERSION_MAJOR;
    constexpr std::int16_t minor = VARNEX3_VERSION_MINOR;
    return ToText(Variant(major)) + u"." + ToText(Variant(minor));
}

void VersionDef::Write(XmlWriter& xml) const
{
    xml.Open("Version");
    xml.Always("XaloVersion", sXaloVersion);
    xml.Close("Version");
}

void VersionDef::Read(const XmlSection& section) { sXaloVersion = section.TextAt("Version/XaloVersion"); }

} // namespace varnex3
