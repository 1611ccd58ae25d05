// A miscellaneous cost on a quote item, and who else does the work.
#pragma once

#include "varnex3/core/Rows.h"

namespace varnex3 {

class QuoteItemMiscellaneousSublet final : public Record
{
    VARNEX_RECORD(QuoteItemMiscellaneousSublet, "Work that is given to another repairer.");
    VARNEX_SERIALISE("The Sublet element with the texts that are not empty; nothing when both are.");
    VARNEX_PARSEXML(Text, "Reads both texts; an absent one is empty.");
    VARNEX_PROPERTY(Text, sSubletType, SubletType, "Kind of work; written without the blanks around it.");
    VARNEX_PROPERTY(Text, sSubletRepairerName, SubletRepairerName, "Name of the other repairer.");

public:
    static constexpr int kLevel = 4;
    VARNEX_RECORD_END;
};

class QuoteItemMiscellaneous final : public Record
{
    VARNEX_RECORD(QuoteItemMiscellaneous, "A miscellaneous cost.");
    VARNEX_SERIALISE("The Miscellaneous element with the value and the sublet.");
    VARNEX_PARSEXML(Text, "Reads the value, an absent one is 0, and the sublet.");
    VARNEX_PROPERTY(double, dMiscellaneousValue, MiscellaneousValue, "Value in dollars.");
    VARNEX_PROPERTY(Child<QuoteItemMiscellaneousSublet>, objSublet, Sublet, "Work that is given to another repairer.");

public:
    static constexpr int kLevel = 3;
    VARNEX_RECORD_END;
};

} // namespace varnex3
