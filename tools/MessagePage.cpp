#include "MessagePage.h"

#include "AmountTable.h"
#include "ErrorTable.h"
#include "FactSheet.h"
#include "ItemTable.h"
#include "MessageOutput.h"
#include "PropertyFacts.h"
#include "ReferenceTables.h"
#include "Summary.h"
#include "varnex3/varnex3.h"

namespace varnex3::tool {

namespace {

Text Joined(const Text& first, const Text& second, TextView between = u" ")
{
    return IsSet(first) && IsSet(second) ? first + Text(between) + second : first + second;
}

// "Assessed (A)"; a code without words as it is.
Text WithCode(const Text& words, const Text& code) { return IsSet(words) ? words + u" (" + code + u")" : code; }

void PrintFields(FactSheet& sheet, const InsurerDetailDef& fields)
{
    for (std::size_t i = 0; i < fields.All().Count(); ++i)
        sheet.Fact(ToUtf8(fields.All().KeyAt(i)), fields.All().ItemAt(i));
}

void Print(FactSheet& sheet, VersionDef& version) { sheet.Fact("Language version", version.XaloVersion()); }

void Print(FactSheet& sheet, SourceDef& source)
{
    sheet.Fact("From", Joined(source.OrgType(), Joined(source.AppName(), source.AppVersion()), u", "));
    sheet.Fact("Sent", source.TimeStamp());
}

void Print(FactSheet& sheet, DestinationDef& destination) { sheet.Fact("To", destination.OrgType()); }

void Print(FactSheet& sheet, InsurerDef& insurer)
{
    sheet.Fact("Name", insurer.UnderwriterName());
    PrintFields(sheet, *insurer.InsurerDetail());
}

void Print(FactSheet& sheet, RepairerDef& repairer)
{
    sheet.Fact("Name", repairer.RepairerName());
    sheet.Fact("ID", repairer.RepairerID());
    PrintFields(sheet, *repairer.RepairerDetails());
}

void Print(FactSheet& sheet, ClaimHeaderDef& claim)
{
    sheet.Fact("Claim", claim.InsuranceClaimNo());
    sheet.Fact("Vehicle ID", claim.VehicleID());
    if (claim.ReinstatementNo() != 0)
        sheet.Fact("Reinstatement", ToText(Variant(claim.ReinstatementNo())));
}

Text KindInWords(RequestDetailsDef& request)
{
    const Text code = request.RequestType();
    const bool isKnown = EqualsIgnoringCase(code, u"A") || EqualsIgnoringCase(code, u"CP");
    const bool isAssessed = request.RequestTypeID() == RequestTypeEnum::RequestAssessed;
    return WithCode(!isKnown ? u"" : isAssessed ? u"Assessed" : u"Allocated", code);
}

void Print(FactSheet& sheet, RequestDetailsDef& request)
{
    const TextList& areas = request.DamagedAreas()->All();
    const bool isOtherParty = request.ClaimantType()->ClaimantType() == ClaimantTypeEnum::OtherParty;
    sheet.Fact("Kind", KindInWords(request));
    sheet.Fact("Requested", request.RequestDate());
    sheet.Fact("Quote expected", request.EstimatedQuoteDate());
    sheet.Fact("Contract", request.ContractText());
    sheet.Fact("Incident", request.IncidentDateTime());
    sheet.Fact("What happened", request.IncidentDescription());
    sheet.List("Damaged areas", {areas.begin(), areas.end()});
    sheet.Flag("Towed", request.VehicleTowed());
    sheet.Flag("Hire car", request.HireCarIndicator());
    sheet.Fact("Claimant", isOtherParty ? u"the other party" : u"the insured");
    sheet.Fact("Claim status", request.ClaimStatus());
    sheet.Fact("Policy", request.PolicyType());
    sheet.Amount("Sum insured", request.SumInsured());
    sheet.Amount("Claim threshold", request.ClaimThreshold());
    sheet.Total("Excess to collect", request.ExcessToCollect());
}

void Print(FactSheet& sheet, VarnexStatusDef& status)
{
    sheet.Fact("Reason of status", status.Reason()); // the status stands with the message's type
}

Text KindInWords(QuoteDetailsDef& quote)
{
    const RepairModelTypeEnum model = quote.QuoteTypeID(); // 0 for an unknown code, too
    const bool isKnown = model != RepairModelTypeEnum::Assessing || quote.QuoteType() == u"A";
    const std::string words = EnumeratorText(EnumerationOf(model), static_cast<std::int32_t>(model));
    return WithCode(isKnown ? ToUtf16(words) : Text(), quote.QuoteType());
}

void Print(FactSheet& sheet, QuoteDetailsDef& quote)
{
    sheet.Fact("Kind", KindInWords(quote));
    sheet.Fact("Quoted by", quote.QuoterName());
    sheet.Fact("Repair begins", quote.EstimatedStartDate());
    sheet.Fact("Repair ends", quote.EstimatedEndDate());
    sheet.Total("Excess to collect", quote.ExcessToCollect());
    sheet.Amount("Owner's contribution", quote.OwnersContributionToCollect()->Value());
    sheet.Fact("Contribution for", quote.OwnersContributionToCollect()->Reason());
    sheet.Fact("Remarks", quote.OpenText());
}

void Print(FactSheet& sheet, VehicleDef& vehicle)
{
    sheet.Fact("Registration", vehicle.RegistrationNo());
    sheet.Fact("Description", vehicle.Description());
    sheet.Fact("Make and model", Joined(vehicle.Make(), Joined(vehicle.ModelID(), vehicle.Series())));
    sheet.Fact("Equipment", vehicle.EquipmentLevel());
    sheet.Fact("Body", vehicle.BodyStyle());
    sheet.Fact("Built", vehicle.BuildDate());
    sheet.Fact("VIN", vehicle.VIN());
    sheet.Fact("Engine no", vehicle.EngineNo());
}

void Print(FactSheet& sheet, VehicleDetailsDef& details)
{
    const auto& odometer = details.Odometer();
    const bool isKilometres = odometer->OdometerUnit() == OdometerUnitEnum::OdometerUnitKm;
    if (IsSet(odometer->OdometerReading()))
        sheet.Fact("Odometer", odometer->OdometerReading() + (isKilometres ? u" km" : u" miles"));
    sheet.Amount("Engine size", details.EngineSize());
    sheet.Fact("Cylinders", details.NoOfCylinders());
    sheet.Fact("Transmission", details.Transmission());
    sheet.Fact("Colour", details.Colour());
    sheet.Fact("Paint group", details.ManufacturerPaintGroup());
    sheet.Fact("Paint code", details.PaintCode());
    sheet.Fact("Trim code", details.ManufacturerTrimCode());
    sheet.Fact("Option code", details.OptionCode());
    sheet.Fact("Where", Joined(details.VehicleLocation(), details.VehicleSuburb(), u", "));
}

void Print(FactSheet& sheet, VehicleModsDef& mods)
{
    std::vector<Text> all;
    all.reserve(static_cast<std::size_t>(mods.Count()));
    for (std::int32_t i = 0; i < mods.Count(); ++i)
        all.push_back(mods.VehicleMods(i));
    sheet.List("Modifications", all);
}

void Print(FactSheet& sheet, HourlyRatesDef& rates)
{
    sheet.Total("Remove, replace", rates.RemoveReplaceHourlyRate());
    sheet.Total("Repair", rates.RepairHourlyRate());
    sheet.Total("Paint", rates.PaintHourlyRate());
    sheet.Total("Mechanical", rates.MechanicalHourlyRate());
}

void Print(FactSheet& sheet, TotalsDef& totals)
{
    sheet.Total("Without tax", totals.GrandTotalExTax());
    sheet.Total("Tax", totals.TaxAmount());
    sheet.Amount("Tax rate", totals.TaxRate());
    sheet.Total("With tax", totals.GrandTotalExTax() + totals.TaxAmount());
}

void Print(FactSheet& sheet, AssessmentDef& assessment)
{
    sheet.Fact("Date", assessment.AssessmentDate());
    sheet.Fact("Assessor", assessment.AssessorName());
    sheet.Fact("Phone", assessment.AssessorPhone());
    sheet.Fact("Mobile", assessment.AssessorMobile());
    sheet.Fact("Fax", assessment.AssessorFax());
    sheet.Fact("Email", assessment.AssessorEmail());
}

void Print(FactSheet& sheet, CustomerDef& customer)
{
    const auto& name = customer.PersonalName();
    sheet.Fact("Name", Joined(name->Title(), name->FullName()));
    sheet.Fact("Company", customer.CompanyName());
    sheet.Fact("Home", name->HomePhone());
    sheet.Fact("Business", customer.BusinessPhone());
    sheet.Fact("Mobile", customer.MobilePhone());
    sheet.Fact("Fax", customer.Fax());
}

void Print(FactSheet& sheet, QuoteItemsDef& items) { PrintItems(sheet, items); }

void Print(FactSheet& sheet, PaymentDetailsDef& invoice)
{
    sheet.Fact("Invoice no", invoice.RepairerTaxInvoiceNo()); // its amounts are a table
    sheet.Fact("Contribution for", invoice.OwnersContributionToCollect()->Reason());
}

void Print(FactSheet& sheet, ExpectedPaymentDetailsDef& expected)
{
    sheet.Fact("Contribution for", expected.OwnersContributionToCollect()->Reason());
}

void Print(FactSheet& sheet, ErrorDetailsDef& errors) { PrintErrors(sheet, errors); }

void Print(FactSheet& sheet, ReferenceDataDef& data) { PrintReferenceData(sheet, data); }

// Where no other words are needed than those of the properties.
void Print(FactSheet& sheet, Record& record) { PrintProperties(sheet, record); }

// Where the page tells an own value of a message, and what it calls it.
struct OwnValuePlace
{
    Name part;
    Name element;
    Name label;
};

constexpr OwnValuePlace kOwnValues[] = {
    {"Message", "RelatesToMessageNo", "About message"},
    {"Message", "QuoteDate", "Quote date"},
    {"Message", "ImageCount", "Images"},
    {"Message", "Defines", "Defines"},
    {"Message", "InspectionReqested", "Inspection for"},
    {"Message", "ImageNo", "Image no"},
    {"Message", "OpenText", "Remarks"},
    {"Vehicle", "RegistrationNo", "Registration"},
    {"Vehicle", "VehicleLocation", "Where"},
    {"Invoice", "TaxInvoiceDate", "Invoice date"},
    {"Invoice", "ReActivateInvoiceDate", "Reactivated"},
    {"Outcome", "Reason", "Reason"},
};

void Print(FactSheet& sheet, const std::vector<OwnValue>& values, Name part)
{
    for (const OwnValuePlace& place : kOwnValues)
        for (const OwnValue& value : values)
            if (place.part == part && place.element == value.element) {
                sheet.Fact(place.label, value.text);
                if (value.error)
                    sheet.Failure(*value.error);
            }
}

// The facts of the section of a class, if the message has it.
template <class T>
void Print(FactSheet& sheet, const std::vector<Section>& sections)
{
    for (const Section& section : sections) {
        if (&section.record->Class() != &T::Info())
            continue;
        Print(sheet, static_cast<T&>(*section.record));
        if (section.error)
            sheet.Failure(*section.error);
    }
}

void PrintSums(FactSheet& sheet, const std::vector<Section>& sections)
{
    for (const Section& section : sections)
        if (&section.record->Class() == &QuoteItemsDef::Info())
            PrintItemsByKind(sheet, static_cast<QuoteItemsDef&>(*section.record));
}

std::vector<AmountColumn> AmountsIn(const std::vector<Section>& sections)
{
    std::vector<AmountColumn> columns;
    for (const Section& section : sections) {
        if (&section.record->Class() == &PaymentDetailsDef::Info())
            columns.push_back({"Invoiced", section.record, !section.error});
        if (&section.record->Class() == &ExpectedPaymentDetailsDef::Info())
            columns.push_back({"Expected", section.record, !section.error});
    }
    return columns;
}

void PrintEnvelope(FactSheet& sheet, const std::vector<OwnValue>& values, const std::vector<Section>& sections)
{
    sheet.Part("Message");
    Print<SourceDef>(sheet, sections);
    Print<DestinationDef>(sheet, sections);
    Print<VersionDef>(sheet, sections);
    Print<VersionChangeDef>(sheet, sections);
    Print<VarnexStatusDef>(sheet, sections);
    Print(sheet, values, "Message");
}

void PrintJob(FactSheet& sheet, const std::vector<OwnValue>& values, const std::vector<Section>& sections)
{
    sheet.Part("Insurer");
    Print<InsurerDef>(sheet, sections);
    sheet.Part("Repairer");
    Print<RepairerDef>(sheet, sections);
    sheet.Part("Claim");
    Print<ClaimHeaderDef>(sheet, sections);
    sheet.Part("Customer");
    Print<CustomerDef>(sheet, sections);
    sheet.Part("Vehicle");
    Print<VehicleDef>(sheet, sections);
    Print<VehicleDetailsDef>(sheet, sections);
    Print<VehicleModsDef>(sheet, sections);
    Print(sheet, values, "Vehicle");
}

void PrintRequestAndQuote(FactSheet& sheet, const std::vector<Section>& sections)
{
    sheet.Part("Request");
    Print<RequestDetailsDef>(sheet, sections);
    sheet.Part("Quote");
    Print<QuoteDetailsDef>(sheet, sections);
    sheet.Part("Assessment");
    Print<AssessmentDef>(sheet, sections);
    sheet.Part("Hourly rates");
    Print<HourlyRatesDef>(sheet, sections);
    sheet.Part("Items");
    Print<QuoteItemsDef>(sheet, sections);
    sheet.Part("Items by kind");
    PrintSums(sheet, sections);
    sheet.Part("Totals");
    Print<TotalsDef>(sheet, sections);
}

void PrintOutcome(FactSheet& sheet, const std::vector<OwnValue>& values, const std::vector<Section>& sections)
{
    sheet.Part("Outcome");
    Print<DeclinedDetailDef>(sheet, sections);
    Print(sheet, values, "Outcome");
    sheet.Part("Payment");
    Print<PayAuthorityDetailsDef>(sheet, sections);
    sheet.Part("Adjustment");
    Print<AdjustmentNoteDetailsDef>(sheet, sections);
    sheet.Part("Invoice");
    Print<TaxInvoiceDetailsDef>(sheet, sections);
    Print<PaymentDetailsDef>(sheet, sections);
    Print(sheet, values, "Invoice");
    sheet.Part("Expected");
    Print<ExpectedPaymentDetailsDef>(sheet, sections);
    sheet.Part("Amounts");
    PrintAmounts(sheet, AmountsIn(sections));
}

void PrintNotice(FactSheet& sheet, const std::vector<Section>& sections)
{
    sheet.Part("Errors");
    Print<ErrorDetailsDef>(sheet, sections);
    sheet.Part("Reference data");
    Print<ReferenceDataDef>(sheet, sections);
}

} // namespace

bool HasPage(MessageDef& message) { return FindMessageClass(ToUtf8(message.MessageType())) != nullptr; }

// A part without facts prints nothing, so that one order of parts does for every message.
void PrintPage(Terminal& terminal, const std::vector<OwnValue>& values, const std::vector<Section>& sections)
{
    FactSheet sheet(terminal);
    PrintEnvelope(sheet, values, sections);
    PrintJob(sheet, values, sections);
    PrintRequestAndQuote(sheet, sections);
    PrintOutcome(sheet, values, sections);
    PrintNotice(sheet, sections);
}

} // namespace varnex3::tool
