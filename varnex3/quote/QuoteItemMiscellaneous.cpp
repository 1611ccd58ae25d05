#include "varnex3/quote/QuoteItemMiscellaneous.h"

namespace varnex3 {

VARNEX_DEFINE(QuoteItemMiscellaneous);
VARNEX_DEFINE(QuoteItemMiscellaneousSublet);

void QuoteItemMiscellaneous::Write(XmlWriter& xml) const
{
    xml.Open("Miscellaneous");
    xml.Always("MiscellaneousValue", dMiscellaneousValue);
    xml.Append(objSublet);
    xml.Close("Miscellaneous");
}

void QuoteItemMiscellaneous::Read(const XmlSection& section)
{
    dMiscellaneousValue = section.NumberAt("Miscellaneous/MiscellaneousValue");
    section.ReadIntoWhereUsed(objSublet, "Miscellaneous/Sublet");
}

void QuoteItemMiscellaneousSublet::Write(XmlWriter& xml) const
{
    if (!IsSet(sSubletType) && !IsSet(sSubletRepairerName))
        return;

    xml.Open("Sublet");
    if (IsSet(sSubletType)) // a type of blanks alone is written, as nothing
        xml.Always("SubletType", Trimmed(sSubletType));
    xml.IfSet("SubletRepairerName", sSubletRepairerName); // not trimmed
    xml.Close("Sublet");
}

void QuoteItemMiscellaneousSublet::Read(const XmlSection& section)
{
    sSubletType = section.TextAt("Sublet/SubletType");
    sSubletRepairerName = section.TextAt("Sublet/SubletRepairerName");
}

} // namespace varnex3
