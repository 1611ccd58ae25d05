#include "varnex3/core/CustomerDef.h"

namespace varnex3 {

VARNEX_DEFINE(CustomerDef);

void CustomerDef::Write(XmlWriter& xml) const
{
    const bool isWritten = XmlWriter::Writes(objPersonalName) || IsSet(sCompanyName) || IsSet(sBusinessPhone)
                           || IsSet(sFax) || IsSet(sMobilePhone);
    if (!isWritten)
        return;

    xml.Open("Customer");
    xml.Append(objPersonalName);
    xml.IfSet("CompanyName", Escaped(sCompanyName));
    xml.IfSet("BusinessPhone", sBusinessPhone);
    xml.IfSet("Fax", sFax);
    xml.IfSet("MobilePhone", sMobilePhone);
    xml.Close("Customer");
}

void CustomerDef::Read(const XmlSection& section)
{
    sCompanyName = section.TextAt("Customer/CompanyName");
    sBusinessPhone = section.TextAt("Customer/BusinessPhone");
    sFax = section.TextAt("Customer/Fax");
    sMobilePhone = section.TextAt("Customer/MobilePhone");
    section.ReadInto(objPersonalName, "Customer/PersonalName");
}

} // namespace varnex3
