#include "varnex3/quote/QuoteItemsDef.h"

#include "varnex3/core/Error.h"

namespace varnex3 {

VARNEX_DEFINE(QuoteItemsDef);

Ref<QuoteItem> QuoteItemsDef::QuoteItems(std::int16_t Index)
{
    const bool isInRange = Index >= 0 && Index < Count();
    return isInRange ? items[static_cast<std::size_t>(Index)] : nullptr;
}

Ref<QuoteItem> QuoteItemsDef::Add()
{
    items.push_back(New<QuoteItem>());
    return items.back();
}

std::int32_t QuoteItemsDef::Count() const { return static_cast<std::int32_t>(items.size()); }

void QuoteItemsDef::Write(XmlWriter& xml) const
{
    if (items.empty())
        return;

    xml.Open("QuoteItems");
    xml.AppendEach(items);
    xml.Close("QuoteItems");
}

void QuoteItemsDef::Read(const XmlSection& section)
{
    constexpr std::size_t kMost = 32768; // what a 16-bit position can reach
    const xml::NodeList found = section.NodesAt("QuoteItems/QuoteItem");
    if (found.size() > kMost)
        Raise(ErrorNumber::Overflow, "QuoteItemsDef.ParseXML",
              u"QuoteItem: " + ToText(Variant(static_cast<std::int32_t>(found.size())))
                  + u" elements are more than the 32768 that one text may have");

    items.reserve(items.size() + found.size());
    for (const xml::Node& node : found) {
        items.push_back(New<QuoteItem>()); // what fails stays in the list, as far as it was read
        items.back()->Read(XmlSection(node, QuoteItem::ClassName));
    }
}

} // namespace varnex3
