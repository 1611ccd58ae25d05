// The vehicle of a job.
#pragma once

#include "varnex3/core/Rows.h"

namespace varnex3 {

class VehicleDef final : public Record
{
    VARNEX_RECORD(VehicleDef, "The identification of the vehicle; every value a text, written as it is.");
    VARNEX_SERIALISE("The Vehicle group with the values that are not empty; nothing when all are.");
    VARNEX_PARSEXML(Variant, "Reads every value; an absent element gives the empty text.");
    VARNEX_PROPERTY(Text, sRegistrationNo, RegistrationNo, "Registration number.");
    VARNEX_PROPERTY(Text, sEngineNo, EngineNo, "Engine number.");
    VARNEX_PROPERTY(Text, sVIN, VIN, "Vehicle identification number.");
    VARNEX_PROPERTY(Text, sBuildDate, BuildDate, "Build date, free text such as 03/2004; not a date.");
    VARNEX_PROPERTY(Text, sMake, Make, "Make.");
    VARNEX_PROPERTY(Text, sModelID, ModelID, "Model.");
    VARNEX_PROPERTY(Text, sSeries, Series, "Series.");
    VARNEX_PROPERTY(Text, sEquipmentLevel, EquipmentLevel, "Equipment level.");
    VARNEX_PROPERTY(Text, sBodyStyle, BodyStyle, "Body style.");
    VARNEX_PROPERTY(Text, sDescription, Description, "Description.");
    VARNEX_RECORD_END;
};

} // namespace varnex3
