// Hours of labour on a quote item: removing and replacing, repairing, or mechanical work.
#pragma once

#include "varnex3/core/Rows.h"

namespace varnex3 {

VARNEX_ENUM(QuoteHoursTypeEnum, "What hours of labour are spent on.",
            (RemoveReplace, 0, "Removing and replacing; written as RemoveReplace."),
            (Repair, 1, "Repairing; written as Repair."), (Mechanical, 2, "Mechanical work; written as Mechanical."),
            (None, 4, "Nothing said: neither written nor read."));

class QuoteHoursDef final : public Record
{
    VARNEX_RECORD(QuoteHoursDef, "Hours of labour and their rate, in an element named by the category.");
    VARNEX_SERIALISE("The category's element: the hours always, the rate when it is above 0. Nothing for None.");
    VARNEX_PARSEXML(Text, "Reads the category's element; an absent value is 0. Nothing is read for None.");
    VARNEX_PROPERTY(double, dHours, Hours, "Number of hours.");
    VARNEX_PROPERTY(double, dHourlyRate, HourlyRate, "Dollars for an hour; 0 is the rate that the quote gives.");
    VARNEX_ACCESSORS(QuoteHoursTypeEnum, Category,
                     "What the hours are spent on, None at first. A number outside the enumeration is stored, but the "
                     "element keeps the name it had.");

public:
    static constexpr int kLevel = 3;
    QuoteHoursDef();

    // The element of a category, and where its values are read.
    struct Element
    {
        Name name;
        ElementPath hours;
        ElementPath hourlyRate;
    };

private:
    const Element* element;
    QuoteHoursTypeEnum eCategory = QuoteHoursTypeEnum::None;
    VARNEX_RECORD_END;
};

// A new record of this category.
template <QuoteHoursTypeEnum category>
Ref<QuoteHoursDef> NewHours()
{
    auto hours = New<QuoteHoursDef>();
    hours->Category(category);
    return hours;
}

} // namespace varnex3
