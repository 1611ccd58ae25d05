#include "varnex3/quote/QuoteItemPaintLabour.h"

namespace varnex3 {

VARNEX_DEFINE(QuoteItemPaintLabour);

void QuoteItemPaintLabour::Write(XmlWriter& xml) const
{
    xml.Open("PaintLabour");
    xml.Always("Hours", dHours);
    if (IsSet(sOtherPaintGroup) && dHourlyRate > 0) { // a rate without a group is dropped, and so is the reverse
        xml.Always("HourlyRate", dHourlyRate);
        xml.Always("OtherPaintGroup", sOtherPaintGroup);
    }
    xml.Close("PaintLabour");
}

void QuoteItemPaintLabour::Read(const XmlSection& section)
{
    dHours = section.NumberAt("PaintLabour/Hours");
    dHourlyRate = section.NumberAt("PaintLabour/HourlyRate");
    sOtherPaintGroup = section.TextAt("PaintLabour/OtherPaintGroup");
}

} // namespace varnex3
