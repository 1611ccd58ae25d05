#include "varnex3/core/XmlSection.h"

#include <algorithm>
#include <array>
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
    constexpr std::size_t kTimeLength = 8;
    const DateTimeParts parts(text);
    const TextView time = parts.time.value_or(TextView()).substr(0, kTimeLength);
    if (time.empty())
        return DateFrom(parts.date);
    std::array<char16_t, DateTimeParts::kDateLength + 1 + kTimeLength> joined; // NOLINT: filled below
    char16_t* end = std::ranges::copy(parts.date, joined.data()).out;
    *end++ = u' ';
    end = std::ranges::copy(time, end).out;
    return DateFrom(TextView(joined.data(), end));
}

} // namespace

bool XmlSection::BeginsHere(ElementPath path) const
{
    if (!path.HasGroup(lastGroup)) {
        lastGroup = path.Group();
        isLastGroup = element.IsElement(lastGroup);
    }
    return isLastGroup;
}

const xml::ChildElements& XmlSection::Children() const
{
    if (!children)
        children.emplace(element);
    return *children;
}

xml::Node XmlSection::Find(ElementPath path) const
{
    if (path.IsGroup())
        return BeginsHere(path) ? element : xml::Node();
    if (!Children().MayHave(path.Bit()) || !BeginsHere(path))
        return {};
    return path.IsDeep() ? element.SelectSingle(path.Inner()) : Children().First(path.Inner(), path.Bit());
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

// Of an element that is there.
template <class Convert>
auto XmlSection::ConvertedOrZero(ElementPath path, Convert convert) const
{
    using Result = decltype(convert(TextView()));
    const xml::Node node = Find(path);
    Text room;
    return node ? Converted(path, node.Text(room), convert) : Result{};
}

Text XmlSection::TextAt(ElementPath path) const { return Find(path).Text(); }

Text XmlSection::RequiredTextAt(ElementPath path) const { return Require(path).Text(); }

double XmlSection::NumberAt(ElementPath path) const { return ConvertedOrZero(path, NumberFrom); }

std::int16_t XmlSection::Int16At(ElementPath path) const { return ConvertedOrZero(path, Int16From); }

std::int32_t XmlSection::Int32At(ElementPath path) const { return ConvertedOrZero(path, Int32From); }

Date XmlSection::RequiredTimestampAt(ElementPath path) const
{
    Text room;
    return Converted(path, Require(path).Text(room), TimestampFrom);
}

Date XmlSection::TimestampAt(ElementPath path) const
{
    Text room;
    return Converted(path, Find(path).Text(room), TimestampFrom);
}

Date XmlSection::TimestampAt(ElementPath path, Date otherwise) const
{
    Text room;
    const TextView text = Find(path).Text(room);
    return IsSet(text) ? Converted(path, text, TimestampFrom) : otherwise;
}

bool XmlSection::Has(ElementPath path) const { return static_cast<bool>(Find(path)); }

xml::NodeList XmlSection::NodesAt(ElementPath path) const
{
    return BeginsHere(path) ? element.Select(path.Inner()) : xml::NodeList();
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
    return node.AttributeValue(0);
}

} // namespace varnex3
