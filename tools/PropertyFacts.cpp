#include "PropertyFacts.h"

#include <algorithm>
#include <iterator>

#include "varnex3/core/Conversions.h"

namespace varnex3::tool {

namespace {

struct Label
{
    Name property;
    Name words;
};

constexpr Label kLabels[] = {
    {"TaxInvoice", "Tax invoice"},
    {"CompletionDate", "Work completed"},
    {"AdjustmentNote", "Adjustment note"},
    {"AdjustmentNoteDate", "Date of the note"},
    {"SupplyDifferenceAmount", "Difference"},
    {"StatutoryStatement", "Statement"},
    {"RepairerTaxInvoiceNo", "Invoice no"},
    {"PayAuthorisedDate", "Authorised"},
    {"PaymentAmount", "Amount"},
    {"DeclinedDate", "Declined"},
    {"ReasonText", "Reason"},
    {"TotalExcludingTax", "Without tax"},
    {"TotalTaxAmount", "Tax"},
    {"TotalIncludingTax", "With tax"},
    {"ExcessToCollect", "Excess to collect"},
    {"OwnersContributionToCollect", "Owner's contribution"},
    {"TotalPayableAmount", "Payable"},
    {"TaxRate", "Tax rate"},
    {"XaloVersion", "Language version"},
    {"VarnexVersion", "Exchange version"},
    {"NextVarnexVersion", "Next exchange version"},
};

void PrintProperty(FactSheet& sheet, const Member& member, const Variant& value)
{
    const Name label = LabelOf(member.name);
    if (member.type.kind == Kind::Double)
        return sheet.Amount(label, std::get<double>(value));
    if (member.type.kind == Kind::Boolean)
        return sheet.Flag(label, std::get<bool>(value));
    if (const auto* const date = std::get_if<Date>(&value))
        return sheet.Fact(label, *date);
    sheet.Fact(label, ToText(value));
}

} // namespace

Name LabelOf(Name property)
{
    const auto* const found = std::ranges::find(kLabels, property, &Label::property);
    return found == std::end(kLabels) ? property : found->words;
}

void PrintProperties(FactSheet& sheet, Record& record)
{
    for (const Member& member : record.Class().members)
        if (member.IsProperty() && !member.IsIndexed() && member.type.kind != Kind::Object)
            PrintProperty(sheet, member, member.get(&record, {}));
}

} // namespace varnex3::tool
