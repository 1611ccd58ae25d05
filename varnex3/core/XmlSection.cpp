#include "varnex3/core/XmlSection.h"

#include <string>

#include "varnex3/core/Conversions.h"
#include "varnex3/core/Error.h"
#include "varnex3/core/modFunctions.h"

namespace varnex3 {

namespace {

std::string ParseXMLOf(Name reader) { return std::string(reader) + ".ParseXML"; }

// Date and time of an ISO text, without fraction and zone.
Date TimestampFrom(TextView text)
{
    Text datePart;
    Text timePart;
    Text zonePart;
    SplitDateTime(text, datePart, timePart, zonePart);
    const Text time = timePart.substr(0, 8);
    return DateFrom(time.empty() ? datePart : datePart + u" " + time);
}

} // namespace

bool XmlSection::IsNamed(Name group) const
{
    if (lastGroup != group) {
        lastGroup = group;
        isLastGroup = element.IsElement(group);
    }
    return isLastGroup;
}

const xml::ChildNames& XmlSection::Names() const
{
    if (!hasNames) {
        hasNames = true;
        names = element.NamesOfChildren();
    }
    return names;
}

// The first child of a name. One that may be there but once is looked for behind the last one found first.
xml::Node XmlSection::FindChild(ElementPath path) const
{
    xml::Node found;
    if (!xml::Has(Names().repeated, path.Bit()))
        found = lastFound.NextSiblingElement(path.Inner());
    if (!found)
        found = element.FirstChildElement(path.Inner());
    if (found)
        lastFound = found;
    return found;
}

xml::Node XmlSection::Find(ElementPath path) const
{
    if (!element || !IsNamed(path.Group()))
        return {};
    if (path.IsGroup())
        return element;
    if (!xml::Has(Names().all, path.Bit()))
        return {};
    return path.IsDeep() ? element.SelectSingle(path.Inner()) : FindChild(path);
}

xml::Node XmlSection::Require(ElementPath path) const
{
    if (const xml::Node node = Find(path))
        return node;
    Raise(ErrorNumber::ObjectNotSet, ParseXMLOf(reader), u"the element " + ToText(path.Whole()) + u" is missing");
}

template <class Convert>
auto XmlSection::Converted(ElementPath path, TextView text, Convert convert) const
{
    try {
        return convert(text);
    } catch (const Error& error) {
        throw error.About(ParseXMLOf(reader), ToText(path.LastStep()));
    }
}

Text XmlSection::TextAt(ElementPath path) const { return Find(path).Text(); }

Text XmlSection::RequiredTextAt(ElementPath path) const { return Require(path).Text(); }

double XmlSection::NumberAt(ElementPath path) const
{
    const xml::Node node = Find(path);
    return node ? Converted(path, node.Text(), NumberFrom) : 0;
}

std::int16_t XmlSection::Int16At(ElementPath path) const
{
    const xml::Node node = Find(path);
    return node ? Converted(path, node.Text(), Int16From) : std::int16_t{0};
}

std::int32_t XmlSection::Int32At(ElementPath path) const
{
    const xml::Node node = Find(path);
    return node ? Converted(path, node.Text(), Int32From) : 0;
}

Date XmlSection::RequiredTimestampAt(ElementPath path) const
{
    return Converted(path, RequiredTextAt(path), TimestampFrom);
}

Date XmlSection::TimestampAt(ElementPath path) const { return Converted(path, TextAt(path), TimestampFrom); }

Date XmlSection::TimestampAt(ElementPath path, Date otherwise) const
{
    const Text text = TextAt(path);
    return IsSet(text) ? Converted(path, text, TimestampFrom) : otherwise;
}

bool XmlSection::Has(ElementPath path) const { return static_cast<bool>(Find(path)); }

xml::NodeList XmlSection::NodesAt(ElementPath path) const
{
    return element && IsNamed(path.Group()) ? element.Select(path.Inner()) : xml::NodeList();
}

xml::Node XmlSection::FirstChildOf(ElementPath path) const { return Find(path).FirstChild(); }

xml::NodeList XmlSection::ElementsNamed(Name tagName) const
{
    xml::NodeList found = element.ElementsByTagName(tagName);
    if (element.IsElement(tagName))
        found.insert(found.begin(), element);
    return found;
}

Text XmlSection::FirstAttributeOf(const xml::Node& node) const
{
    if (node.AttributeCount() == 0)
        Raise(ErrorNumber::ObjectNotSet, ParseXMLOf(reader), u"the element " + node.Name() + u" has no attribute");
    return node.AttributeAt(0).value;
}

} // namespace varnex3
