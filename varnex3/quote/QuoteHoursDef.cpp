#include "varnex3/quote/QuoteHoursDef.h"

namespace varnex3 {

VARNEX_DEFINE(QuoteHoursDef);

namespace {

using Element = QuoteHoursDef::Element;
using enum QuoteHoursTypeEnum;

constexpr Element kNameless{"", "Hours", "HourlyRate"}; // an element without a name is no step of a path

struct ElementOf
{
    QuoteHoursTypeEnum category;
    Element element;
};

constexpr ElementOf kElements[] = {
    {RemoveReplace, {"RemoveReplace", "RemoveReplace/Hours", "RemoveReplace/HourlyRate"}},
    {Repair, {"Repair", "Repair/Hours", "Repair/HourlyRate"}},
    {Mechanical, {"Mechanical", "Mechanical/Hours", "Mechanical/HourlyRate"}},
    {None, kNameless},
};

} // namespace

QuoteHoursDef::QuoteHoursDef() : element(&kNameless) {}

QuoteHoursTypeEnum QuoteHoursDef::Category() { return eCategory; }

void QuoteHoursDef::Category(QuoteHoursTypeEnum value)
{
    eCategory = value;
    for (const ElementOf& row : kElements)
        if (row.category == value)
            element = &row.element;
}

void QuoteHoursDef::Write(XmlWriter& xml) const
{
    if (eCategory == None)
        return;

    xml.Open(element->name);
    xml.Always("Hours", dHours);
    xml.IfPositive("HourlyRate", dHourlyRate);
    xml.Close(element->name);
}

void QuoteHoursDef::Read(const XmlSection& section)
{
    if (eCategory == None)
        return;

    dHours = section.NumberAt(element->hours);
    dHourlyRate = section.NumberAt(element->hourlyRate);
}

} // namespace varnex3
