// What an hour of the repairer's work costs.
#pragma once

#include "varnex3/core/Rows.h"

namespace varnex3 {

class HourlyRatesDef final : public Record
{
    VARNEX_RECORD(HourlyRatesDef, "The repairer's hourly rates, in dollars.");
    VARNEX_SERIALISE("The HourlyRates group with all four rates; nothing when none is greater than 0.");
    VARNEX_PARSEXML(Variant, "Reads the rates; an absent one is 0, one that is no number raises TypeMismatch (13).");
    VARNEX_PROPERTY(double, dMechanicalHourlyRate, MechanicalHourlyRate, "Rate of mechanical work.");
    VARNEX_PROPERTY(double, dPaintHourlyRate, PaintHourlyRate, "Rate of painting.");
    VARNEX_PROPERTY(double, dRepairHourlyRate, RepairHourlyRate, "Rate of repairing.");
    VARNEX_PROPERTY(double, dRemoveReplaceHourlyRate, RemoveReplaceHourlyRate, "Rate of removing and replacing.");
    VARNEX_RECORD_END;
};

} // namespace varnex3
