#include "varnex3/quote/QuoteItemPaintMaterials.h"

namespace varnex3 {

VARNEX_DEFINE(QuoteItemPaintMaterials);

void QuoteItemPaintMaterials::Write(XmlWriter& xml) const
{
    xml.Open("PaintMaterials");
    xml.Always("PaintValue", dPaintValue);
    xml.Close("PaintMaterials");
}

void QuoteItemPaintMaterials::Read(const XmlSection& section)
{
    dPaintValue = section.NumberAt("PaintMaterials/PaintValue");
}

} // namespace varnex3
