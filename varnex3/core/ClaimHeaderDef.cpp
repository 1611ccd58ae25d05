#include "varnex3/core/ClaimHeaderDef.h"

namespace varnex3 {

VARNEX_DEFINE(ClaimHeaderDef);

void ClaimHeaderDef::Write(XmlWriter& xml) const
{
    const bool isWritten =
        IsSet(sVehicleID) || IsSet(sInsuranceClaimNo); // the reinstatement number alone does not count
    if (!isWritten)
        return;

    xml.Open("ClaimHeader");
    xml.IfSet("VehicleID", sVehicleID);
    xml.IfSet("InsuranceClaimNo", sInsuranceClaimNo);
    xml.Always("ReinstatementNo", lReinstatementNo);
    xml.Close("ClaimHeader");
}

void ClaimHeaderDef::Read(const XmlSection& section)
{
    sVehicleID = section.TextAt("ClaimHeader/VehicleID");
    sInsuranceClaimNo = section.TextAt("ClaimHeader/InsuranceClaimNo");
    lReinstatementNo = section.Int32At("ClaimHeader/ReinstatementNo");
}

} // namespace varnex3
