#include "varnex3/quote/TotalsDef.h"

namespace varnex3 {

VARNEX_DEFINE(TotalsDef);

void TotalsDef::Write(XmlWriter& xml) const
{
    xml.Open("Totals");
    xml.Always("GrandTotalExTax", dGrandTotalExTax);
    xml.Always("TaxRate", dTaxRate); // with two decimals, too
    xml.Always("TaxAmount", dTaxAmount);
    xml.Close("Totals");
}

void TotalsDef::Read(const XmlSection& section)
{
    dGrandTotalExTax = section.NumberAt("Totals/GrandTotalExTax");
    dTaxRate = section.NumberAt("Totals/TaxRate");
    dTaxAmount = section.NumberAt("Totals/TaxAmount");
}

} // namespace varnex3
