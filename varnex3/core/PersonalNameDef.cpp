#include "varnex3/core/PersonalNameDef.h"

namespace varnex3 {

VARNEX_DEFINE(PersonalNameDef);

Text PersonalNameDef::FullName() const { return IsSet(sForname) ? sForname + u" " + sSurname : sSurname; }

void PersonalNameDef::Write(XmlWriter& xml) const
{
    const bool isWritten = IsSet(sTitle) || IsSet(sForname) || IsSet(sSurname) || IsSet(sHomePhone);
    if (!isWritten)
        return;

    xml.Open("PersonalName");
    xml.IfSet("Title", Escaped(sTitle)); // the only value here that is escaped
    xml.IfSet("Forname", sForname);
    xml.Always("Surname", sSurname); // also when empty
    xml.IfSet("HomePhone", sHomePhone);
    xml.Close("PersonalName");
}

void PersonalNameDef::Read(const XmlSection& section)
{
    sTitle = section.TextAt("PersonalName/Title");
    sForname = section.TextAt("PersonalName/Forname");
    sSurname = section.TextAt("PersonalName/Surname");
    sHomePhone = section.TextAt("PersonalName/HomePhone");
}

} // namespace varnex3
