// What an invoice comes to, and beside it what the insurer expected.
#pragma once

#include <string>
#include <vector>

#include "FactSheet.h"
#include "varnex3/core/Interface.h"

namespace varnex3::tool {

// Records whose amounts have the same names.
struct AmountColumn
{
    std::string title;
    Ref<Record> record;
    bool isWhole = true; // if not, an amount of 0 may be one that was not read
};

// An amount a line, those of each record below each other; of two also the difference. Totals are told when they are 0,
// too.
void PrintAmounts(FactSheet& sheet, const std::vector<AmountColumn>& columns);

} // namespace varnex3::tool
