#include "varnex3/core/XmlWriter.h"

#include <algorithm>
#include <string>

#include "varnex3/core/Conversions.h"
#include "varnex3/core/Error.h"
#include "varnex3/core/modFunctions.h"

namespace varnex3 {

void XmlWriter::Put(TextView text)
{
    if (length < room.size())
        std::copy_n(text.begin(), std::min(text.size(), room.size() - length),
                    room.begin() + static_cast<std::ptrdiff_t>(length));
    length += text.size();
}

void XmlWriter::Put(Name name)
{
    if (length < room.size())
        std::copy_n(name.begin(), std::min(name.size(), room.size() - length),
                    room.begin() + static_cast<std::ptrdiff_t>(length));
    length += name.size();
}

void XmlWriter::StartLine()
{
    for (int i = 0; i < level; ++i)
        Put(TextView(u"\t"));
}

void XmlWriter::PutStartTag(Name element)
{
    Put(TextView(u"<"));
    Put(element);
    Put(TextView(u">"));
}

void XmlWriter::PutEndTag(Name element)
{
    Put(TextView(u"</"));
    Put(element);
    Put(TextView(u">"));
}

void XmlWriter::Open(Name group)
{
    StartLine();
    PutStartTag(group);
    EndLine();
    ++level;
}

void XmlWriter::Close(Name group)
{
    --level;
    StartLine();
    PutEndTag(group);
    EndLine();
}

void XmlWriter::OpenMessage(Name root)
{
    Line(u"<?xml version=\"1.0\" encoding=\"UTF-8\"?>");
    StartLine();
    Put(TextView(u"<"));
    Put(root);
    Put(TextView(u" xmlns:xsi=\"http://www.w3.org/2001/XMLSchema-instance\" xsi:noNamespaceSchemaLocation=\""));
    Put(root);
    Put(TextView(u".xsd\">"));
    EndLine();
    ++level;
}

void XmlWriter::CloseMessageWithoutLineEnd(Name root)
{
    --level;
    PutEndTag(root);
}

XmlWriter::Mark XmlWriter::OpenUnlessEmpty(Name group)
{
    const std::size_t before = length;
    Open(group);
    return {group, before, length};
}

void XmlWriter::CloseUnlessEmpty(const Mark& mark)
{
    if (length > mark.inside)
        return Close(mark.group);
    --level;
    length = mark.before; // the start tag is taken back
}

void XmlWriter::Always(Name element, TextView value)
{
    StartLine();
    PutStartTag(element);
    Put(value);
    PutEndTag(element);
    EndLine();
}

void XmlWriter::Always(Name element, Date value) { Always(element, TextView(FormatDate(value, 0))); }

void XmlWriter::Always(Name element, double amount)
{
    try {
        Always(element, TextView(FormatAmount(amount)));
    } catch (const Error& error) {
        throw error.About(std::string(record) + ".Serialise", ToText(element));
    }
}

void XmlWriter::Always(Name element, std::int32_t value) { Always(element, TextView(ToText(Variant(value)))); }

void XmlWriter::IfSet(Name element, TextView value)
{
    if (IsSet(value))
        Always(element, value);
}

void XmlWriter::IfSet(Name element, Date value)
{
    if (IsSet(value))
        Always(element, value);
}

void XmlWriter::IfPositive(Name element, double amount)
{
    if (amount > 0)
        Always(element, amount);
}

void XmlWriter::Flag(Name element, bool isSet)
{
    if (!isSet)
        return;
    StartLine();
    Put(TextView(u"<"));
    Put(element);
    Put(TextView(u"/>"));
    EndLine();
}

void XmlWriter::Line(TextView text)
{
    StartLine();
    Put(text);
    EndLine();
}

void XmlWriter::AlwaysWithAttribute(Name element, Name attribute, TextView about, TextView value)
{
    StartLine();
    Put(TextView(u"<"));
    Put(element);
    Put(TextView(u" "));
    Put(attribute);
    Put(TextView(u"=\""));
    Put(about);
    Put(TextView(u"\">"));
    Put(value);
    PutEndTag(element);
    EndLine();
}

} // namespace varnex3
