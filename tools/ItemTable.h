// The items of a quote as a table, and what they come to by kind.
#pragma once

#include "FactSheet.h"
#include "varnex3/quote/QuoteItemsDef.h"

namespace varnex3::tool {

// A line an item: its hours and rate, or its amount, and what else its kind says. Columns that find no room are left
// out, the comment first.
void PrintItems(FactSheet& sheet, QuoteItemsDef& items);

// For each kind that there is, how many items, how many hours, and their value; then all items.
void PrintItemsByKind(FactSheet& sheet, QuoteItemsDef& items);

} // namespace varnex3::tool
