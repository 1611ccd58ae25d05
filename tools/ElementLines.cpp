#include "ElementLines.h"

#include <algorithm>
#include <iterator>
#include <limits>
#include <set>
#include <string>
#include <utility>

#include "varnex3/Library.h"

namespace varnex3::tool {

namespace {

// What is in lists; everything else that classes read is called like a property or a constant.
constexpr Name kItemNames[] = {"QuoteItem", "DataType", "DataValue", "DamagedArea", "VehicleMod"};

// Each attribute is found by walking to it, so of very many only these are listed, and the number of the others.
constexpr std::size_t kListedAttributes = 100;

void AddAttributes(std::vector<ElementLine>& lines, std::size_t depth, const xml::Node& element)
{
    const std::size_t count = element.AttributeCount();
    for (std::size_t i = 0; i < std::min(count, kListedAttributes); ++i) {
        xml::Attribute attribute = element.AttributeAt(i);
        lines.push_back({depth, u"@" + attribute.name, std::move(attribute.value)});
    }
    if (count > kListedAttributes)
        lines.push_back({depth, u"@", ToUtf16(std::to_string(count - kListedAttributes) + " more")});
}

void AddLine(std::vector<ElementLine>& lines, std::size_t depth, const xml::Node& element)
{
    const bool isGroup = static_cast<bool>(FirstElementFrom(element.FirstChild()));
    lines.push_back({depth, element.Name(), isGroup ? std::nullopt : std::optional(element.Text())});
    AddAttributes(lines, depth + 1, element);
}

// The names of a class's properties, of the constants that they may have, and the same of the records in them.
void AddNames(std::set<Name>& names, std::set<const ClassInfo*>& classes, const ClassInfo* info)
{
    if (!info || !classes.insert(info).second)
        return;
    for (const Member& member : info->members) {
        if (member.IsProperty())
            names.insert(member.name);
        if (member.type.enumeration)
            for (const Enumerator& constant : member.type.enumeration->values)
                names.insert(constant.name);
        if (member.type.kind == Kind::Object)
            AddNames(names, classes, FindClass(member.type.name));
    }
}

std::set<Name> KnownNames(const ClassInfo& info)
{
    std::set<Name> names(std::begin(kItemNames), std::end(kItemNames));
    std::set<const ClassInfo*> classes;
    AddNames(names, classes, &info);
    return names;
}

// Which lines are unknown or stand below one that is.
std::vector<bool> Unknown(const std::vector<ElementLine>& lines, const ClassInfo& info)
{
    const std::set<Name> names = KnownNames(info);
    const auto isKnown = [&](const ElementLine& line) {
        return line.depth == 0 || line.name.starts_with(u'@') || names.contains(ToUtf8(line.name));
    };
    std::vector<bool> unknown;
    constexpr std::size_t kNone = std::numeric_limits<std::size_t>::max();
    std::size_t depth = kNone; // of the unknown line above
    for (const ElementLine& line : lines) {
        if (line.depth <= depth)
            depth = isKnown(line) ? kNone : line.depth;
        unknown.push_back(line.depth >= depth);
    }
    return unknown;
}

} // namespace

xml::Node FirstElementFrom(xml::Node node)
{
    while (node && node.Type() != xml::NodeType::Element)
        node = node.NextSibling();
    return node;
}

// Without recursion, for a file may be nested as deep as its author likes.
std::vector<ElementLine> LinesOf(const xml::Node& element)
{
    std::vector<ElementLine> lines;
    std::vector<xml::Node> open = {element};
    AddLine(lines, 0, element);
    xml::Node next = FirstElementFrom(element.FirstChild());
    while (next || open.size() > 1) {
        if (!next) {
            next = FirstElementFrom(open.back().NextSibling());
            open.pop_back();
            continue;
        }
        AddLine(lines, open.size(), next);
        open.push_back(next);
        next = FirstElementFrom(next.FirstChild());
    }
    return lines;
}

std::vector<ElementLine> UnknownLinesOf(const xml::Node& element, const ClassInfo& info)
{
    std::vector<ElementLine> lines = LinesOf(element);
    const std::vector<bool> unknown = Unknown(lines, info);
    std::vector<ElementLine> kept;
    std::size_t wanted = 0; // lines above of a lower depth are what the last kept one stands in
    for (std::size_t i = lines.size(); i-- > 0;) {
        if (!unknown[i] && lines[i].depth >= wanted)
            continue;
        wanted = lines[i].depth;
        kept.push_back(std::move(lines[i]));
    }
    std::ranges::reverse(kept);
    return kept;
}

} // namespace varnex3::tool
