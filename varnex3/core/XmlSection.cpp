#include "varnex3/core/XmlSection.h"

#include <string>

#include "varnex3/core/Conversions.h"
#include "varnex3/core/Error.h"
#include "varnex3/core/modFunctions.h"

namespace varnex3 {

namespace {

std::string ParseXMLOf(Name reader) { return std::string(reader) + ".ParseXML"; }

Name LastStep(Name path) { return path.substr(path.rfind('/') + 1); }

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

xml::Node XmlSection::Find(Name path) const
{
    const std::size_t slash = path.find('/');
    if (!element.IsElement(path.substr(0, slash)))
        return {};
    return slash == Name::npos ? element : element.SelectSingle(path.substr(slash + 1));
}

xml::Node XmlSection::Require(Name path) const
{
    if (const xml::Node node = Find(path))
        return node;
    Raise(ErrorNumber::ObjectNotSet, ParseXMLOf(reader), u"the element " + ToText(path) + u" is missing");
}

template <class Convert>
auto XmlSection::Converted(Name path, TextView text, Convert convert) const
{
    try {
        return convert(text);
    } catch (const Error& error) {
        throw error.About(ParseXMLOf(reader), ToText(LastStep(path)));
    }
}

Text XmlSection::TextAt(Name path) const { return Find(path).Text(); }

Text XmlSection::RequiredTextAt(Name path) const { return Require(path).Text(); }

double XmlSection::NumberAt(Name path) const
{
    const xml::Node node = Find(path);
    return node ? Converted(path, node.Text(), [](TextView text) { return NumberFrom(text); }) : 0;
}

std::int16_t XmlSection::Int16At(Name path) const
{
    const xml::Node node = Find(path);
    return node ? Converted(path, node.Text(), [](TextView text) { return ToInt16(Text(text)); }) : std::int16_t{0};
}

std::int32_t XmlSection::Int32At(Name path) const
{
    const xml::Node node = Find(path);
    return node ? Converted(path, node.Text(), [](TextView text) { return ToInt32(Text(text)); }) : 0;
}

Date XmlSection::RequiredTimestampAt(Name path) const { return Converted(path, RequiredTextAt(path), TimestampFrom); }

Date XmlSection::TimestampAt(Name path) const { return Converted(path, TextAt(path), TimestampFrom); }

Date XmlSection::TimestampAt(Name path, Date otherwise) const
{
    const Text text = TextAt(path);
    return IsSet(text) ? Converted(path, text, TimestampFrom) : otherwise;
}

bool XmlSection::Has(Name path) const { return static_cast<bool>(Find(path)); }

xml::NodeList XmlSection::NodesAt(Name path) const
{
    const std::size_t slash = path.find('/');
    return element.IsElement(path.substr(0, slash)) ? element.Select(path.substr(slash + 1)) : xml::NodeList();
}

xml::Node XmlSection::FirstChildOf(Name path) const { return Find(path).FirstChild(); }

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
