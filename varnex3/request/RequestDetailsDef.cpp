#include "varnex3/request/RequestDetailsDef.h"

namespace varnex3 {

VARNEX_DEFINE(RequestDetailsDef);

namespace {

struct TypeRow
{
    RequestTypeEnum id;
    TextView code;
};

constexpr TypeRow kRequestTypes[] = {
    {RequestTypeEnum::RequestAssessed, u"A"},
    {RequestTypeEnum::RequestAllocated, u"CP"},
};

} // namespace

Text RequestDetailsDef::RequestType() { return sRequestType; }

void RequestDetailsDef::RequestType(Text value)
{
    sRequestType = std::move(value);
    DeriveRequestTypeID();
}

RequestTypeEnum RequestDetailsDef::RequestTypeID()
{
    DeriveRequestTypeID(); // the code may have come from ParseXML
    return eRequestTypeID;
}

void RequestDetailsDef::RequestTypeID(RequestTypeEnum value)
{
    eRequestTypeID = value;
    for (const TypeRow& type : kRequestTypes)
        if (type.id == value)
            sRequestType = type.code; // any other number leaves the code as it was
}

void RequestDetailsDef::DeriveRequestTypeID()
{
    for (const TypeRow& type : kRequestTypes)
        if (EqualsIgnoringCase(sRequestType, type.code))
            eRequestTypeID = type.id; // any other code leaves the number as it was
}

Text RequestDetailsDef::RequestTypeDesciption() const
{
    return FindDescription(*repairModels, sRequestType).value_or(Text());
}

void RequestDetailsDef::Write(XmlWriter& xml) const
{
    xml.Open("RequestDetails");
    xml.IfSet("RequestType", sRequestType);
    xml.IfSet("RequestDate", dtRequestDate);
    xml.IfSet("ContractText", sContractText);
    xml.IfSet("IncidentDateTime", sIncidentDateTime);
    xml.IfSet("IncidentDescription", sIncidentDescription);
    xml.Flag("VehicleTowed", bVehicleTowed);
    WriteDamagedAreas(xml);
    WriteClaimantType(xml);
    xml.IfSet("PolicyType", sPolicyType); // before the amounts, although it is the last value
    xml.IfPositive("SumInsured", dSumInsured);
    xml.IfPositive("ClaimThreshold", dClaimThreshold);
    xml.Always("ExcessToCollect", dExcessToCollect); // 0 and less, too
    xml.IfSet("EstimatedQuoteDate", dtEstimatedQuoteDate);
    xml.Flag("HireCarIndicator", bHireCarIndicator);
    xml.IfSet("ClaimStatus", sClaimStatus);
    xml.Close("RequestDetails");
}

void RequestDetailsDef::WriteDamagedAreas(XmlWriter& xml) const
{
    if (objDamagedAreas->Count() < 1)
        return;

    xml.Open("DamagedAreas");
    for (const Text& area : objDamagedAreas->All())
        xml.Always("DamagedArea", area);
    xml.Close("DamagedAreas");
}

void RequestDetailsDef::WriteClaimantType(XmlWriter& xml) const
{
    xml.Open("ClaimantType");
    xml.Line(u"<" + objClaimantType->ClaimantTypeValue() + u"/>"); // a number of no claimant: </>
    xml.Close("ClaimantType");
}

void RequestDetailsDef::Read(const XmlSection& section)
{
    sRequestType = section.TextAt("RequestDetails/RequestType"); // as it is: RequestTypeID is not derived here
    dtRequestDate = section.TimestampAt("RequestDetails/RequestDate");
    sContractText = section.TextAt("RequestDetails/ContractText");
    sIncidentDateTime = section.TextAt("RequestDetails/IncidentDateTime");
    sIncidentDescription = section.TextAt("RequestDetails/IncidentDescription");
    bVehicleTowed = section.Has("RequestDetails/VehicleTowed");
    ReadDamagedAreas(section);
    section.ReadRequiredInto(objClaimantType, "RequestDetails/ClaimantType");
    sPolicyType = section.TextAt("RequestDetails/PolicyType");
    dSumInsured = section.NumberAt("RequestDetails/SumInsured");
    dClaimThreshold = section.NumberAt("RequestDetails/ClaimThreshold");
    dExcessToCollect = section.NumberAt("RequestDetails/ExcessToCollect");
    dtEstimatedQuoteDate = section.TimestampAt("RequestDetails/EstimatedQuoteDate"); // may be left out by Write
    bHireCarIndicator = section.Has("RequestDetails/HireCarIndicator");
    sClaimStatus = section.TextAt("RequestDetails/ClaimStatus");
}

void RequestDetailsDef::ReadDamagedAreas(const XmlSection& section)
{
    for (const xml::Node& area : section.ElementsNamed("DamagedAreas/DamagedArea"))
        objDamagedAreas->Add(area.Text());
}

} // namespace varnex3
