#include "Example.h"

#include <algorithm>
#include <vector>

#include "varnex3/core/Conversions.h"

namespace varnex3::tool {

namespace {

struct ExampleValue
{
    Name member;   // of any class, or Class.Member; a parameter of Add without the prefix of its type
    TextView text; // converted to the member's type; several, for the items of a list in turn, are separated by |
};

// What is not here has its own name in words, the number 1, the date of the quote.
constexpr ExampleValue kValues[] = {
    // envelope
    {"XaloVersion", u"2.1"},
    {"VarnexVersion", u"3.0"},
    {"NextVarnexVersion", u"3.1"},
    {"SourceDef.OrgType", u"REP"},
    {"DestinationDef.OrgType", u"INS"},
    {"AppName", u"Workshop"},
    {"AppVersion", u"2.1"},
    {"TimeStamp", u"2008-05-14T11:20:05"},
    {"MessageNoField", u"5012"},
    {"RelatesToMessageNoField", u"5011"},
    {"QuoteNoField", u"Q005933"},
    // parties
    {"UnderwriterName", u"Coolabah Insurance"},
    {"RepairerID", u"R03170"},
    {"RepairerName", u"Merriweather Smash Repairs"},
    {"InsurerDetailDef.FieldName", u"Suburb|Phone"},
    {"InsurerDetailDef.Value", u"Ferny Ridge|(03) 5550 0162"},
    // claim, vehicle and customer
    {"VehicleID", u"V005933"},
    {"InsuranceClaimNo", u"CL-2008-005933"},
    {"RegistrationNo", u"TWQ63P"},
    {"RegistrationNoField", u"TWQ63P"},
    {"EngineNo", u"CR305933"},
    {"VIN", u"6ZZCRV31RDG205933"},
    {"BuildDate", u"02/2006"},
    {"Make", u"Currawong"},
    {"ModelID", u"Vale"},
    {"Series", u"II"},
    {"EquipmentLevel", u"Touring"},
    {"BodyStyle", u"Hatchback"},
    {"VehicleDef.Description", u"Currawong Vale Hatchback"},
    {"Title", u"Mr"},
    {"Forname", u"Tomasz"},
    {"Surname", u"Okonjo"},
    {"CompanyName", u"Okonjo & Daughters"},
    {"HomePhone", u"(03) 5550 0177"},
    {"BusinessPhone", u"(03) 5550 0178"},
    {"Fax", u"(03) 5550 0179"},
    {"MobilePhone", u"0491 570 157"},
    // request
    {"RequestType", u"A"},
    {"RequestDate", u"2008-05-12"},
    {"ContractText", u"Repairs under the network agreement"},
    {"IncidentDateTime", u"2008-05-10 17:40"},
    {"IncidentDescription", u"Run into from behind at a roundabout"},
    {"DamagedAreasDef.Value", u"Rear bumper|Tailgate"},
    {"VehicleModsDef.Value", u"Tow bar|Roof racks"},
    {"SumInsured", u"18200"},
    {"ClaimThreshold", u"9000"},
    {"ExcessToCollect", u"400"},
    {"EstimatedQuoteDate", u"2008-05-15"},
    {"ClaimStatus", u"Open"},
    {"PolicyType", u"Comprehensive"},
    // quote
    {"VarnexStatusDef.Reason", u"Within the claim threshold"},
    {"InspectionReason", u"Boot floor may be bent"},
    {"QuoteType", u"A"},
    {"EstimatedStartDate", u"2008-05-19"},
    {"EstimatedEndDate", u"2008-05-23"},
    {"OpenText", u"Boot floor to be measured once bumper & lining are off"},
    {"QuoterName", u"J. Merriweather"},
    {"OwnersContributionToCollectDef.Value", u"80"},
    {"OwnersContributionToCollectDef.Reason", u"Old scratch on the tailgate"},
    {"OdometerReading", u"41870"},
    {"EngineSize", u"2.4"},
    {"NoOfCylinders", u"4"},
    {"Transmission", u"Automatic"},
    {"Colour", u"Saltbush Green"},
    {"PaintCode", u"SG7"},
    {"VehicleLocation", u"Workshop"},
    {"VehicleLocationField", u"Workshop, Ferny Ridge"},
    {"VehicleSuburb", u"Ferny Ridge"},
    {"RemoveReplaceHourlyRate", u"82"},
    {"RepairHourlyRate", u"82"},
    {"PaintHourlyRate", u"88"},
    {"MechanicalHourlyRate", u"104"},
    {"GrandTotalExTax", u"1527.40"},
    {"TaxRate", u"10"},
    {"TaxAmount", u"152.74"},
    {"AssessorName", u"P. Lindqvist"},
    {"AssessorPhone", u"(03) 5550 0190"},
    {"AssessorMobile", u"0491 570 158"},
    {"AssessorFax", u"(03) 5550 0191"},
    {"AssessorEmail", u"assessing@coolabah.example"},
    {"DefinesField", u"Standard times"},
    {"ImageCountField", u"2"},
    // items, one a kind
    {"ItemNo", u"1|2|3|4|5|6|7|8"},
    {"QuoteItem.Code", u"1010|1022|2022|2900|3150|4000|5010|6000"},
    {"QuoteItem.Description",
     u"Remove and replace rear bumper|Repair tailgate|Paint tailgate and bumper|Paint materials|"
     u"Rear bumper bar|Calibrate parking sensors|Check rear wheel alignment|Tow from roundabout"},
    {"QuoteItemValue", u"164|164|180|158.40|385|120|208|148"},
    {"QuoteHoursDef.Hours", u"2"},
    {"QuoteHoursDef.HourlyRate", u"82|82|82|82|82|82|104|82"},
    {"QuoteItemPaintLabour.Hours", u"2"},
    {"QuoteItemPaintLabour.HourlyRate", u"90"},
    {"OtherPaintGroup", u"Pearl"},
    {"PaintValue", u"158.40"},
    {"PartValue", u"385"},
    {"PartNumber", u"CR-52159-0V2"},
    {"PartSourceCode", u" "}, // from the vehicle's maker, as it is read
    {"PartOrientationCode", u"R"},
    {"MiscellaneousValue", u"120"},
    {"SubletType", u"Electrical"},
    {"SubletRepairerName", u"Ferny Ridge Auto Electrics"},
    {"TowingValue", u"148"},
    {"QuoteItem.Comment", u"As agreed by phone"},
    {"QuoteItemTypeString", u"R&R|RA|Paint|MIS|Part|MIS|R&R|MIS"},
    {"TypeDescription", u"R&R|Repair|Paint|Misc|Part|Misc|R&R|Misc"},
    // invoices and payments
    {"RepairerTaxInvoiceNo", u"INV-2291"},
    {"TaxInvoiceDate", u"2008-05-26"},
    {"CompletionDate", u"2008-05-23"},
    {"TaxInvoiceDetailsDef.Description", u"Repairs as quoted"},
    {"TotalExcludingTax", u"1527.40"},
    {"TotalTaxAmount", u"152.74"},
    {"TotalIncludingTax", u"1680.14"},
    {"TotalPayableAmount", u"1200.14"},
    {"PaymentAmount", u"1200.14"},
    {"PayAuthorisedDate", u"2008-06-10"},
    {"AdjustmentNoteDate", u"2008-06-02"},
    {"SupplyDifferenceAmount", u"-42.50"},
    {"StatutoryStatement", u"This document is an adjustment note"},
    {"ReActivateInvoiceDateField", u"2008-06-04"},
    {"DeclinedDate", u"2008-05-13"},
    {"ReasonText", u"No room in the workshop before June"},
    {"ReasonField", u"The owner has changed the repairer"},
    {"Xalo_PaymentDeclined.ReasonField", u"The total is not the authorised one"},
    {"OpenTextField", u"Please call before noon"},
    // notices
    {"Severity", u"E"},
    {"SeverityDescription", u"Error"},
    {"ErrorDetailsDefDataContentError.Description", u"The element has a value that is not allowed"},
    {"ErrorDetailsDefMessageOrderError.Description", u"A message is missing"},
    {"ErrorDetailsDefMessageTypeError.Description", u"The message is not expected at this time"},
    {"ErrorDetailsDefMiscellaneousError.Description", u"The message was not processed"},
    {"ElementName", u"RegistrationNo"},
    {"ErrorDetailsDefDataContentError.Value", u"TWQ63P?"},
    {"ExpectedMessageNo", u"5010"},
    {"ReceivedMessageNo", u"5011"},
    {"ImageNoField", u"1"},
    {"NameAttribute", u"ERRORSEVERITY|REPAIRMODELTYPE"},
    {"ReferenceDataDefDataTypeDataValue.Code", u"A|B"},
    {"ReferenceDataDefDataTypeDataValue.Description", u"First|Second"},
};

constexpr Name kLeftAlone[] = {
    "QuoteHoursDef.Category",               // set by the item that has the hours
    "PaymentDetailsDef.PaymentDetailsType", // set by the message that has the figures
    "Xalo_AdjustmentNote.OpenTextField",    // its end tag has another name: no reader would take the message
};

std::string FullName(const ClassInfo& info, Name member) { return std::string(info.name) + "." + std::string(member); }

// Of the texts between | that of a position; they come again from the first.
TextView PartOf(TextView texts, std::size_t position)
{
    const auto count = static_cast<std::size_t>(std::ranges::count(texts, u'|')) + 1;
    for (std::size_t i = position % count; i > 0; --i)
        texts.remove_prefix(texts.find(u'|') + 1);
    return texts.substr(0, texts.find(u'|'));
}

const ExampleValue* FindValue(const ClassInfo& info, Name member)
{
    const std::string fullName = FullName(info, member);
    for (const Name name : {Name(fullName), member})
        if (const auto found = std::ranges::find(kValues, name, &ExampleValue::member); found != std::end(kValues))
            return found;
    return nullptr;
}

// ManufacturerPaintGroup is "Manufacturer paint group".
Text InWords(Name member)
{
    const auto isCapital = [](char c) { return c >= 'A' && c <= 'Z'; };
    Text words;
    for (std::size_t i = 0; i < member.size(); ++i) {
        const bool isFirstOfWord = i > 0 && isCapital(member[i]) && !isCapital(member[i - 1]);
        words += isFirstOfWord ? u" " : u"";
        words += static_cast<char16_t>(isFirstOfWord ? member[i] + ('a' - 'A') : member[i]);
    }
    return words;
}

Variant ValueOf(const ClassInfo& info, Name member, const Type& type, std::size_t position)
{
    if (const ExampleValue* const value = FindValue(info, member))
        return Text(PartOf(value->text, position));
    switch (type.kind) {
    case Kind::Text:
        return InWords(member);
    case Kind::Date:
        return Text(u"2008-05-14");
    case Kind::Boolean:
        return true;
    case Kind::Enumeration:
        return type.enumeration->values[position % type.enumeration->values.size()].value;
    default:
        return 1;
    }
}

// Whether a child is the record of a kind, and this item is of another: QuoteItemPart names the child Part.
bool IsOfOtherKind(const ClassInfo& info, Name child, std::size_t position)
{
    for (const Member& member : info.members) {
        if (member.type.kind != Kind::Enumeration)
            continue;
        const auto kinds = member.type.enumeration->values;
        for (std::size_t i = 0; i < kinds.size(); ++i)
            if (kinds[i].name.ends_with(child) && i != position % kinds.size())
                return true;
    }
    return false;
}

// Enough for an item of every kind, and not one alone.
std::size_t ItemCount(const ClassInfo& item)
{
    std::size_t count = 2;
    for (const Member& member : item.members)
        if (member.type.kind == Kind::Enumeration)
            count = std::max(count, member.type.enumeration->values.size());
    return count;
}

void Fill(Record& record, std::size_t position);

void AddRecords(Record& list, const Member& add)
{
    std::size_t count = 1;
    for (std::size_t i = 0; i < count; ++i) {
        const Ref<Record> item = std::get<Ref<Record>>(Call(list, add.name));
        count = ItemCount(item->Class());
        Fill(*item, i);
    }
}

void AddValues(Record& list, const Member& add)
{
    constexpr std::size_t kCount = 2;
    for (std::size_t i = 0; i < kCount; ++i) {
        std::vector<Variant> arguments;
        for (const Parameter& parameter : add.Parameters())
            arguments.push_back(ValueOf(list.Class(), parameter.name.substr(1), parameter.type, i));
        Call(list, add.name, arguments);
    }
}

void FillMember(Record& record, const Member& member, std::size_t position)
{
    const ClassInfo& info = record.Class();
    const bool isPlain = member.IsProperty() && !member.IsIndexed();
    const bool isLeftAlone = std::ranges::find(kLeftAlone, FullName(info, member.name)) != std::end(kLeftAlone);
    if (isPlain && member.type.kind == Kind::Object && !IsOfOtherKind(info, member.name, position))
        Fill(*std::get<Ref<Record>>(Get(record, member.name)), position);
    else if (isPlain && member.type.kind != Kind::Object && member.IsWritable() && !isLeftAlone)
        Put(record, member.name, ValueOf(info, member.name, member.type, position));
}

void Fill(Record& record, std::size_t position)
{
    for (const Member& member : record.Class().members)
        FillMember(record, member, position);
    const Member* const add = FindMember(record.Class(), "Add");
    if (add && add->Parameters().empty())
        AddRecords(record, *add);
    else if (add)
        AddValues(record, *add);
}

} // namespace

Ref<Record> ExampleOf(const ClassInfo& info)
{
    Ref<Record> record = info.create();
    Fill(*record, 0);
    return record;
}

} // namespace varnex3::tool
