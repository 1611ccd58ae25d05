#include "varnex3/quote/HourlyRatesDef.h"

namespace varnex3 {

VARNEX_DEFINE(HourlyRatesDef);

void HourlyRatesDef::Write(XmlWriter& xml) const
{
    const bool isWritten =
        dMechanicalHourlyRate > 0 || dPaintHourlyRate > 0 || dRepairHourlyRate > 0 || dRemoveReplaceHourlyRate > 0;
    if (!isWritten)
        return;

    xml.Open("HourlyRates");
    xml.Always("MechanicalHourlyRate", dMechanicalHourlyRate); // one rate brings all four
    xml.Always("PaintHourlyRate", dPaintHourlyRate);
    xml.Always("RepairHourlyRate", dRepairHourlyRate);
    xml.Always("RemoveReplaceHourlyRate", dRemoveReplaceHourlyRate);
    xml.Close("HourlyRates");
}

void HourlyRatesDef::Read(const XmlSection& section)
{
    dMechanicalHourlyRate = section.NumberAt("HourlyRates/MechanicalHourlyRate");
    dPaintHourlyRate = section.NumberAt("HourlyRates/PaintHourlyRate");
    dRepairHourlyRate = section.NumberAt("HourlyRates/RepairHourlyRate");
    dRemoveReplaceHourlyRate = section.NumberAt("HourlyRates/RemoveReplaceHourlyRate");
}

} // namespace varnex3
