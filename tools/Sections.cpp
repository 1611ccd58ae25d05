#include "Sections.h"

#include <algorithm>
#include <iterator>

#include "varnex3/varnex3.h"

namespace varnex3::tool {

namespace {

struct SectionClass
{
    Name element;
    Ref<Record> (*create)();
    Name root = {};       // of the messages that have it; any when empty
    bool isEvery = false; // see Section
};

template <class T>
Ref<Record> Make()
{
    return New<T>();
}

Ref<Record> MakeLastInvoice() { return NewLastInvoiceDetails(); }

constexpr Name kRequest = Xalo_RequestForQuote::ClassName;
constexpr Name kQuote = Xalo_Quote::ClassName;

// In the order in which messages have them; a class for one kind of message before the one for all.
constexpr SectionClass kClasses[] = {
    {"Version", Make<VersionChangeDef>, Xalo_VarnexVersionChange::ClassName},
    {"Version", Make<VersionDef>},
    {"Source", Make<SourceDef>},
    {"Destination", Make<DestinationDef>},
    {"Insurer", Make<InsurerDef>},
    {"Repairer", Make<RepairerDef>},
    {"ClaimHeader", Make<ClaimHeaderDef>},
    {"RequestDetails", Make<RequestDetailsDef>, kRequest},
    {"VarnexStatus", Make<VarnexStatusDef>, kQuote},
    {"QuoteDetails", Make<QuoteDetailsDef>, kQuote},
    {"Vehicle", Make<VehicleDef>},
    {"VehicleMods", Make<VehicleModsDef>, kRequest},
    {"VehicleDetails", Make<VehicleDetailsDef>, kQuote},
    {"HourlyRates", Make<HourlyRatesDef>, kQuote},
    {"QuoteItems", Make<QuoteItemsDef>, kQuote},
    {"Totals", Make<TotalsDef>, kQuote},
    {"Assessment", Make<AssessmentDef>, kQuote},
    {"Customer", Make<CustomerDef>},
    {"TaxInvoiceDetail", Make<TaxInvoiceDetailsDef>, Xalo_TaxInvoice::ClassName},
    {"AdjustmentNoteDetails", Make<AdjustmentNoteDetailsDef>, Xalo_AdjustmentNote::ClassName},
    {"PaymentDetails", Make<PaymentDetailsDef>},
    {"PayAuthorityDetails", Make<PayAuthorityDetailsDef>, Xalo_PaymentAuthorised::ClassName},
    {"LastInvoiceDetails", MakeLastInvoice, Xalo_PaymentDeclined::ClassName},
    {"ExpectedPaymentDetails", Make<ExpectedPaymentDetailsDef>, Xalo_PaymentDeclined::ClassName},
    {"DeclinedDetail", Make<DeclinedDetailDef>, Xalo_Declined::ClassName},
    {"ErrorDetails", Make<ErrorDetailsDef>, Xalo_Error::ClassName, true},
    {"ReferenceData", Make<ReferenceDataDef>, Xalo_VarnexReferenceData::ClassName},
};

// The class for an element of this name below that root, or null.
const SectionClass* ClassFor(const xml::Node& root, Name element)
{
    const auto* const found = std::ranges::find_if(kClasses, [&](const SectionClass& entry) {
        return entry.element == element && (entry.root.empty() || root.IsElement(entry.root));
    });
    return found == std::end(kClasses) ? nullptr : found;
}

void ReadByRows(Record& record, const xml::Node& node)
{
    for (const Member& member : record.Class().members) {
        if (!member.IsProperty() || !member.IsWritable())
            continue;
        if (const xml::Node value = node.SelectSingle(member.name)) // a flag says yes by being there
            Put(record, member.name, member.type.kind == Kind::Boolean ? Variant(true) : Variant(value.Text()));
    }
}

void ReadInto(Section& section, const xml::Node& node)
{
    try {
        if (!FindMember(section.record->Class(), "ParseXML"))
            return ReadByRows(*section.record, node);
        Variant markup = node.Xml();
        Call(*section.record, "ParseXML", {&markup, 1});
    } catch (const Error& error) {
        if (!section.error) // the first of several elements
            section.error = error;
    }
}

} // namespace

std::vector<Section> ReadSections(const xml::Document& document)
{
    const xml::Node root = document.DocumentElement();
    std::vector<Section> sections;
    for (const SectionClass& entry : kClasses) {
        const xml::NodeList nodes = root.Select(entry.element);
        if (nodes.empty() || ClassFor(root, entry.element) != &entry)
            continue;
        Section& section = sections.emplace_back(Section{entry.element, entry.create(), {}, entry.isEvery});
        const std::size_t count = entry.isEvery ? nodes.size() : 1;
        for (std::size_t i = 0; i < count; ++i)
            ReadInto(section, nodes[i]);
    }
    return sections;
}

} // namespace varnex3::tool
