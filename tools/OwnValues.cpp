#include "OwnValues.h"

#include <algorithm>
#include <map>
#include <string>
#include <utility>

#include "varnex3/varnex3.h"

namespace varnex3::tool {

namespace {

constexpr Name kQuote = Xalo_Quote::ClassName;
constexpr Name kInspection = "InspectionReqested";

// In the order in which messages have them.
constexpr Name kOwnElements[] = {
    "RelatesToMessageNo",    "QuoteDate", "ImageCount", "Defines",         "RegistrationNo", "ImageNo",
    "ReActivateInvoiceDate", "OpenText",  "Reason",     "VehicleLocation",
};

// The date of an invoice, which its class writes and does not read.
constexpr std::pair<Name, Name> kInvoiceDates[] = {{"PaymentDetails", "TaxInvoiceDate"},
                                                   {"LastInvoiceDetails", "TaxInvoiceDate"}};

// Why a quote could not read its own value of this name.
std::optional<Error> WhyNotRead(const xml::Node& message, Name element)
{
    const XmlSection section(message, kQuote);
    try {
        if (message.IsElement(kQuote) && element == "QuoteDate")
            section.TimestampAt("Xalo_Quote/QuoteDate");
        if (message.IsElement(kQuote) && element == "ImageCount")
            section.Int16At("Xalo_Quote/ImageCount");
    } catch (const Error& error) {
        return error;
    }
    return std::nullopt;
}

bool IsOwnValue(const xml::Node& message, Name element)
{
    return std::ranges::count(kOwnElements, element) > 0 || (element == kInspection && message.IsElement(kQuote));
}

// Of an error report the summary has another number.
bool IsInSummary(const xml::Node& message, Name element)
{
    return element == "QuoteNo" || (element == "MessageNo" && !message.IsElement(Xalo_Error::ClassName));
}

bool IsTold(const xml::Node& message, Name element)
{
    return IsOwnValue(message, element) || IsInSummary(message, element);
}

// What nothing else tells of an element below the root that is the nth of its name, from 0.
std::vector<ElementLine> UntoldLines(const xml::Node& element, const Section* section, std::size_t n)
{
    const bool isRead = section && !section->error && (n == 0 || section->isEvery);
    return isRead ? UnknownLinesOf(element, section->record->Class()) : LinesOf(element);
}

} // namespace

std::vector<OwnValue> ReadOwnValues(const xml::Document& document)
{
    const xml::Node message = document.DocumentElement();
    std::vector<OwnValue> values;
    for (const Name element : kOwnElements)
        if (const xml::Node node = message.SelectSingle(element))
            values.push_back({element, node.Text(), WhyNotRead(message, element)});
    for (const auto& [section, element] : kInvoiceDates)
        if (const xml::Node node = message.SelectSingle(section).SelectSingle(element))
            values.push_back({element, node.Text(), {}});
    const xml::Node inspection = message.SelectSingle(kInspection);
    if (message.IsElement(kQuote) && inspection.AttributeCount() > 0)
        values.push_back({kInspection, inspection.AttributeAt(0).value, {}});
    return values;
}

std::vector<ElementLine> ReadOtherValues(const xml::Document& document, const std::vector<Section>& sections)
{
    const xml::Node message = document.DocumentElement();
    std::vector<ElementLine> lines;
    std::map<std::string, std::size_t> met;
    for (xml::Node node = FirstElementFrom(message.FirstChild()); node; node = FirstElementFrom(node.NextSibling())) {
        const std::string name = ToUtf8(node.Name());
        const std::size_t n = met[name]++;
        if (n == 0 && IsTold(message, name))
            continue;
        const auto section = std::ranges::find(sections, name, &Section::element);
        const std::vector<ElementLine> untold = UntoldLines(node, section == sections.end() ? nullptr : &*section, n);
        lines.insert(lines.end(), untold.begin(), untold.end());
    }
    return lines;
}

} // namespace varnex3::tool
