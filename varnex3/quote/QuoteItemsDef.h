// The lines of a quote.
#pragma once

#include <vector>

#include "varnex3/quote/QuoteItem.h"

namespace varnex3 {

class QuoteItemsDef final : public Record
{
    VARNEX_RECORD(QuoteItemsDef, "The items of a quote, in the order in which they were added. None is ever removed.");
    VARNEX_SERIALISE("The QuoteItems element with every item; nothing when there is none.");
    VARNEX_PARSEXML(Text,
                    "Appends an item for each QuoteItem element; the items before them stay. More than 32,768 elements "
                    "raise Overflow (6) before any is added.");
    VARNEX_INDEXED_READONLY(Ref<QuoteItem>, QuoteItems, (std::int16_t Index),
                            "The item at a position, from 0; nothing when there is none.");
    VARNEX_METHOD(Ref<QuoteItem>, Add, (), "Appends a new item and returns it.");
    VARNEX_READONLY(std::int32_t, Count, "Number of items.");

private:
    std::vector<Ref<QuoteItem>> items;
    VARNEX_RECORD_END;
};

} // namespace varnex3
