// Towing on a quote item.
#pragma once

#include "varnex3/core/Rows.h"

namespace varnex3 {

class QuoteItemTowing final : public Record
{
    VARNEX_RECORD(QuoteItemTowing, "What towing costs.");
    VARNEX_SERIALISE("The Towing element with the value.");
    VARNEX_PARSEXML(Text, "Reads the value; an absent one is 0.");
    VARNEX_PROPERTY(double, dTowingValue, TowingValue, "Value in dollars.");

public:
    static constexpr int kLevel = 3;
    VARNEX_RECORD_END;
};

} // namespace varnex3
