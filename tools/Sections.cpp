#include "Sections.h"

#include "varnex3/varnex3.h"

namespace varnex3::tool {

namespace {

struct SectionClass
{
    Name element;
    const ClassInfo& info;
    Name root = {}; // of the messages that have it; any when empty
};

Section Read(const SectionClass& entry, const xml::Node& node)
{
    Section section{entry.element, entry.info.create(), {}};
    try {
        Variant markup = node.Xml();
        Call(*section.record, "ParseXML", {&markup, 1});
    } catch (const Error& error) {
        section.error = error;
    }
    return section;
}

// Why a quote could not read its own value of this name.
std::optional<Error> WhyNotRead(const xml::Node& quote, Name element)
{
    const XmlSection section(quote, Xalo_Quote::ClassName);
    try {
        if (element == "QuoteDate")
            section.TimestampAt("Xalo_Quote/QuoteDate");
        if (element == "ImageCount")
            section.Int16At("Xalo_Quote/ImageCount");
    } catch (const Error& error) {
        return error;
    }
    return std::nullopt;
}

} // namespace

std::vector<OwnValue> ReadOwnValues(const xml::Document& document)
{
    const xml::Node root = document.DocumentElement();
    std::vector<OwnValue> values;
    if (!root.IsElement(Xalo_Quote::ClassName))
        return values;
    for (const Name element : {"QuoteDate", "ImageCount", "Defines"})
        if (const xml::Node node = root.SelectSingle(element))
            values.push_back({element, node.Text(), WhyNotRead(root, element)});
    const xml::Node inspection = root.SelectSingle("InspectionReqested");
    if (inspection && inspection.AttributeCount() > 0)
        values.push_back({"InspectionReqested", inspection.AttributeAt(0).value, {}});
    return values;
}

std::vector<Section> ReadSections(const xml::Document& document)
{
    constexpr Name kRequest = Xalo_RequestForQuote::ClassName;
    constexpr Name kQuote = Xalo_Quote::ClassName;
    const SectionClass classes[] = {
        {"Version", VersionDef::Info()},
        {"Source", SourceDef::Info()},
        {"Destination", DestinationDef::Info()},
        {"Insurer", InsurerDef::Info()},
        {"Repairer", RepairerDef::Info()},
        {"ClaimHeader", ClaimHeaderDef::Info()},
        {"RequestDetails", RequestDetailsDef::Info(), kRequest},
        {"VarnexStatus", VarnexStatusDef::Info(), kQuote},
        {"QuoteDetails", QuoteDetailsDef::Info(), kQuote},
        {"Vehicle", VehicleDef::Info()},
        {"VehicleMods", VehicleModsDef::Info(), kRequest},
        {"VehicleDetails", VehicleDetailsDef::Info(), kQuote},
        {"HourlyRates", HourlyRatesDef::Info(), kQuote},
        {"QuoteItems", QuoteItemsDef::Info(), kQuote},
        {"Totals", TotalsDef::Info(), kQuote},
        {"Assessment", AssessmentDef::Info(), kQuote},
        {"Customer", CustomerDef::Info()},
    };
    const xml::Node root = document.DocumentElement();
    std::vector<Section> sections;
    for (const SectionClass& entry : classes) {
        const xml::Node node = root.SelectSingle(entry.element);
        if (node && (entry.root.empty() || root.IsElement(entry.root)))
            sections.push_back(Read(entry, node));
    }
    return sections;
}

} // namespace varnex3::tool
