// What an insurer asks a repairer to quote for.
#pragma once

#include <memory>

#include "varnex3/core/ReferenceSet.h"
#include "varnex3/core/Rows.h"
#include "varnex3/request/ClaimantTypeDef.h"
#include "varnex3/request/DamagedAreasDef.h"

namespace varnex3 {

VARNEX_ENUM(RequestTypeEnum, "How the repair is to be decided on.", (RequestAssessed, 0, "The damage is assessed: A."),
            (RequestAllocated, 1, "The job is allocated to the repairer: CP."));

// A new record loads the reference set of the repair models, REPAIRMODELTYPE, and keeps it. Without a database the set
// is empty; what the database itself refuses is raised.
class RequestDetailsDef final : public Record
{
    VARNEX_RECORD(RequestDetailsDef, "The request: its kind, the incident, the damage, the claimant and the amounts.");
    VARNEX_SERIALISE("The RequestDetails group, always written: claimant and excess at least. No text is escaped.");
    VARNEX_PARSEXML(Variant, "Reads every value; RequestTypeID is not derived here, damaged areas are appended. Raises "
                             "TypeMismatch (13) where RequestDate or EstimatedQuoteDate is missing or no date, or an "
                             "amount no number, and ObjectNotSet (91) where ClaimantType is missing.");
    VARNEX_ACCESSORS(Text, RequestType,
                     "Code of the request. Setting A or CP, in any letter case, sets RequestTypeID, too.");
    VARNEX_PROPERTY(Date, dtRequestDate, RequestDate, "When the request was made; the day alone is written.");
    VARNEX_PROPERTY(Text, sContractText, ContractText, "Text of the contract.");
    VARNEX_PROPERTY(Text, sIncidentDateTime, IncidentDateTime, "When the incident happened: a text, never converted.");
    VARNEX_PROPERTY(Text, sIncidentDescription, IncidentDescription, "What happened.");
    VARNEX_PROPERTY(bool, bVehicleTowed, VehicleTowed, "Whether the vehicle was towed.");
    VARNEX_PROPERTY(Child<DamagedAreasDef>, objDamagedAreas, DamagedAreas, "Damaged areas of the vehicle.");
    VARNEX_PROPERTY(Child<ClaimantTypeDef>, objClaimantType, ClaimantType, "Who makes the claim.");
    VARNEX_PROPERTY(double, dSumInsured, SumInsured, "Sum insured, in dollars; written when greater than 0.");
    VARNEX_PROPERTY(double, dClaimThreshold, ClaimThreshold,
                    "Threshold of the claim, in dollars; written when greater than 0.");
    VARNEX_PROPERTY(double, dExcessToCollect, ExcessToCollect,
                    "Excess to collect from the owner, in dollars; always written.");
    VARNEX_PROPERTY(Date, dtEstimatedQuoteDate, EstimatedQuoteDate,
                    "When the quote is expected; left out when it is the zero date, and then not read back.");
    VARNEX_PROPERTY(bool, bHireCarIndicator, HireCarIndicator, "Whether there is a hire car.");
    VARNEX_PROPERTY(Text, sClaimStatus, ClaimStatus, "Status of the claim.");
    VARNEX_PROPERTY(Text, sPolicyType, PolicyType, "Type of the policy.");
    VARNEX_ACCESSORS(RequestTypeEnum, RequestTypeID,
                     "Kind of the request, derived from RequestType where that is A or CP. Setting 0 or 1 sets "
                     "RequestType to A or CP.");
    VARNEX_READONLY(Text, RequestTypeDesciption,
                    "Description of RequestType from the reference set, empty when it is not there; the name is "
                    "spelled so. A code with an apostrophe cannot be looked up: 3001, unless there is no set.");

private:
    void DeriveRequestTypeID();
    void WriteDamagedAreas(XmlWriter& xml) const;
    void WriteClaimantType(XmlWriter& xml) const;
    void ReadDamagedAreas(const XmlSection& section);

    Text sRequestType;
    RequestTypeEnum eRequestTypeID{};
    std::shared_ptr<RowSet> repairModels = GetReferenceSet(u"REPAIRMODELTYPE", u"");
    VARNEX_RECORD_END;
};

} // namespace varnex3
