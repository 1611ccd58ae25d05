// The materials of painting on a quote item.
#pragma once

#include "varnex3/core/Rows.h"

namespace varnex3 {

class QuoteItemPaintMaterials final : public Record
{
    VARNEX_RECORD(QuoteItemPaintMaterials, "What the paint costs.");
    VARNEX_SERIALISE("The PaintMaterials element with the value.");
    VARNEX_PARSEXML(Text, "Reads the value; an absent one is 0.");
    VARNEX_PROPERTY(double, dPaintValue, PaintValue, "Value in dollars.");

public:
    static constexpr int kLevel = 3;
    VARNEX_RECORD_END;
};

} // namespace varnex3
