// What a quote comes to.
#pragma once

#include "varnex3/core/Rows.h"

namespace varnex3 {

class TotalsDef final : public Record
{
    VARNEX_RECORD(TotalsDef, "The totals of a quote.");
    VARNEX_SERIALISE("The Totals group, always written whole.");
    VARNEX_PARSEXML(Text, "Reads the values; an absent one is 0, one that is no number raises TypeMismatch (13).");
    VARNEX_PROPERTY(double, dGrandTotalExTax, GrandTotalExTax, "Total without tax, in dollars.");
    VARNEX_PROPERTY(double, dTaxRate, TaxRate, "Rate of the tax; two decimals are written.");
    VARNEX_PROPERTY(double, dTaxAmount, TaxAmount, "The tax, in dollars.");
    VARNEX_RECORD_END;
};

} // namespace varnex3
