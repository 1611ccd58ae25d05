#include "varnex3/quote/QuoteItemTowing.h"

namespace varnex3 {

VARNEX_DEFINE(QuoteItemTowing);

void QuoteItemTowing::Write(XmlWriter& xml) const
{
    xml.Open("Towing");
    xml.Always("TowingValue", dTowingValue);
    xml.Close("Towing");
}

void QuoteItemTowing::Read(const XmlSection& section) { dTowingValue = section.NumberAt("Towing/TowingValue"); }

} // namespace varnex3
