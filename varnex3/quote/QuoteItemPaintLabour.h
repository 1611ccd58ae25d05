// The labour of painting on a quote item.
#pragma once

#include "varnex3/core/Rows.h"

namespace varnex3 {

class QuoteItemPaintLabour final : public Record
{
    VARNEX_RECORD(QuoteItemPaintLabour, "Hours of painting.");
    VARNEX_SERIALISE(
        "The PaintLabour element with the hours. Rate and paint group are written together or not at all: when the "
        "group is not empty and the rate above 0.");
    VARNEX_PARSEXML(Text, "Reads every value; an absent one is 0 or the empty text.");
    VARNEX_PROPERTY(double, dHours, Hours, "Number of hours.");
    VARNEX_PROPERTY(double, dHourlyRate, HourlyRate, "Dollars for an hour in another paint group.");
    VARNEX_PROPERTY(Text, sOtherPaintGroup, OtherPaintGroup, "The paint group that has a rate of its own.");

public:
    static constexpr int kLevel = 3;
    VARNEX_RECORD_END;
};

} // namespace varnex3
