// Request and quote read through their sections as each section's record reads its own markup.
#include "tests/MessageSections.h"
#include "varnex3/quote/Xalo_Quote.h"
#include "varnex3/request/Xalo_RequestForQuote.h"

using namespace varnex3;
using namespace varnex3::tests;

namespace {

SectionForm Customer()
{
    return {"CustomerField", u"Customer", u"", {u"PersonalName", u"Title", u"Forname", u"Surname", u"Fax"}};
}

// In the order in which they are read.
SectionForms SectionsOfRequest()
{
    SectionForms forms = Envelope();
    forms.insert(
        forms.end(),
        {{"RequestDetailsField",
          u"RequestDetails",
          u"<RequestDate>2004-05-06</RequestDate><ClaimantType/><EstimatedQuoteDate>2004-05-20</EstimatedQuoteDate>",
          {u"RequestType", u"RequestDate", u"VehicleTowed", u"DamagedAreas", u"DamagedArea", u"ClaimantType",
           u"OtherParty", u"Insured", u"SumInsured", u"ClaimStatus"}},
         Vehicle(),
         {"VehicleModsField", u"VehicleMods", u"", {u"VehicleMod", u"VehicleMods"}},
         Customer()});
    return forms;
}

SectionForms SectionsOfQuote()
{
    SectionForms forms = Envelope();
    forms.insert(forms.end(),
                 {{"VarnexStatusField", u"VarnexStatus", u"", {u"Status", u"Reason", u"VarnexStatus"}},
                  {"InspectionReqestedField", u"Inspection", u"", {u"InspectionReqested", u"InspectionReason"}},
                  {"QuoteDetailsField",
                   u"QuoteDetails",
                   u"",
                   {u"QuoteType", u"EstimatedStartDate", u"ExcessToCollect", u"OwnersContributionToCollect", u"Value",
                    u"Reason", u"OpenText"}},
                  Vehicle(),
                  {"VehicleDetailsField",
                   u"VehicleDetails",
                   u"",
                   {u"Odometer", u"OdometerReading", u"OdometerUnitKm", u"OdometerUnitMiles", u"EngineSize", u"Colour",
                    u"ManufacturerPaintGroup"}},
                  {"HourlyRatesField", u"HourlyRates", u"", {u"MechanicalHourlyRate", u"PaintHourlyRate"}},
                  {"QuoteItemsField",
                   u"QuoteItems",
                   u"",
                   {u"QuoteItem", u"ItemNo", u"Code", u"RemoveReplace", u"Hours", u"Part", u"PartSource", u"OEM",
                    u"PaintLabour", u"ReportOn"}},
                  {"TotalsField", u"Totals", u"", {u"GrandTotalExTax", u"TaxRate", u"TaxAmount"}},
                  {"AssessmentField", u"Assessment", u"", {u"AssessmentDate", u"AssessorName", u"AssessorEmail"}},
                  Customer()});
    return forms;
}

} // namespace

TEST_CASE("Xalo_RequestForQuote: each section reads from the whole message as from its own markup")
{
    CompareSections<Xalo_RequestForQuote>(SectionsOfRequest(), u"");
}

TEST_CASE("Xalo_RequestForQuote: the whole message reads as its sections one by one, also to the same error")
{
    const auto [read, failed] = CompareReadings<Xalo_RequestForQuote>(SectionsOfRequest(), u"", 11);
    CHECK(read > 100);
    CHECK(failed > 100);
}

TEST_CASE("Xalo_Quote: each section reads from the whole message as from its own markup")
{
    CompareSections<Xalo_Quote>(SectionsOfQuote(), u"<QuoteDate>2004-05-07</QuoteDate>");
}

TEST_CASE("Xalo_Quote: the whole message reads as its sections one by one, also to the same error")
{
    const auto [read, failed] =
        CompareReadings<Xalo_Quote>(SectionsOfQuote(), u"<QuoteDate>2004-05-07</QuoteDate>", 12);
    CHECK(read > 100);
    CHECK(failed > 100);
}
