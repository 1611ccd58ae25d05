#include "varnex3/core/XmlWriter.h"

#include <algorithm>
#include <string>

#include "varnex3/core/Conversions.h"
#include "varnex3/core/Error.h"
#include "varnex3/core/modFunctions.h"

namespace varnex3 {

namespace {

constexpr TextView kLineEnd = u"\r\n";

constexpr std::size_t LengthOf(char /*character*/) { return 1; }
constexpr std::size_t LengthOf(Name name) { return name.size(); }
constexpr std::size_t LengthOf(TextView text) { return text.size(); }
constexpr std::size_t LengthOf(Escaped text) { return text.Length(); }

char16_t* Put(char16_t* to, char character)
{
    *to = static_cast<char16_t>(character);
    return to + 1;
}
char16_t* Put(char16_t* to, Name name) { return std::copy(name.begin(), name.end(), to); }
char16_t* Put(char16_t* to, TextView text) { return std::copy(text.begin(), text.end(), to); }
char16_t* Put(char16_t* to, Escaped text) { return text.Put(to); }

constexpr TextView kTabs = u"\t\t\t\t\t\t\t\t";

// Writes always as many as one instruction does, of which the rest is written over: there is room for that.
char16_t* PutTabs(char16_t* to, std::size_t count)
{
    if (count > kTabs.size()) [[unlikely]]
        return std::fill_n(to, count, u'\t');
    kTabs.copy(to, kTabs.size());
    return to + count;
}

} // namespace

template <class... Part>
void XmlWriter::PutLine(Part... parts)
{
    const auto tabs = static_cast<std::size_t>(level);
    const std::size_t start = length;
    length += tabs + (LengthOf(parts) + ...);
    if (length + kTabs.size() > room.size()) [[unlikely]] {
        if (!keepsText)
            return;
        Grow(start);
    }
    char16_t* to = PutTabs(room.data() + start, tabs);
    ((to = Put(to, parts)), ...);
}

// What stands before the line that does not fit is kept.
void XmlWriter::Grow(std::size_t written)
{
    constexpr std::size_t kStep = std::size_t{8} * 1024; // what is written stays near the processor
    const std::size_t needed = length + kTabs.size();
    if (needed > grown.capacity())
        Move(written);
    grown.resize(std::max(needed, std::min(grown.capacity(), needed + kStep)));
    room = grown;
}

// A list goes on as it began, give or take an eighth.
void XmlWriter::Move(std::size_t written)
{
    std::size_t wanted = 2 * length;
    if (list.done > 0)
        wanted = length + (written - list.start) / list.done * (list.count - list.done);
    Text larger;
    larger.reserve(wanted + wanted / 8 + kTabs.size());
    larger.assign(room.data(), written);
    grown = std::move(larger);
}

Text XmlWriter::Taken()
{
    if (grown.empty())
        return {room.data(), length};
    grown.resize(length);
    return std::move(grown);
}

void XmlWriter::OpenMessage(Name root)
{
    PutLine(Name("<?xml version=\"1.0\" encoding=\"UTF-8\"?>"), kLineEnd);
    PutLine('<', root,
            Name(" xmlns:xsi=\"http://www.w3.org/2001/XMLSchema-instance\" xsi:noNamespaceSchemaLocation=\""), root,
            Name(".xsd\">"), kLineEnd);
    ++level;
}

void XmlWriter::CloseMessageWithoutLineEnd(Name root)
{
    --level;
    PutLine(Name("</"), root, '>');
}

void XmlWriter::Open(Name group)
{
    PutLine('<', group, '>', kLineEnd);
    ++level;
}

void XmlWriter::OpenWithAttribute(Name group, Name attribute, TextView about)
{
    PutLine('<', group, ' ', attribute, Name("=\""), about, Name("\">"), kLineEnd);
    ++level;
}

void XmlWriter::Close(Name group)
{
    --level;
    PutLine(Name("</"), group, '>', kLineEnd);
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
    PutLine('<', element, '>', value, Name("</"), element, '>', kLineEnd);
}

void XmlWriter::Always(Name element, Escaped value)
{
    PutLine('<', element, '>', value, Name("</"), element, '>', kLineEnd);
}

void XmlWriter::Always(Name element, Date value) { Always(element, DateText(value, 0).View()); }

void XmlWriter::Always(Name element, double amount)
{
    if (NumberText text; text.PutAmount(amount))
        return Always(element, text.View());
    try {
        Always(element, TextView(FormatAmount(amount)));
    } catch (const Error& error) {
        throw error.About(std::string(record) + ".Serialise", ToText(element));
    }
}

void XmlWriter::Always(Name element, std::int32_t value) { Always(element, NumberText(value).View()); }

void XmlWriter::IfSet(Name element, TextView value)
{
    if (IsSet(value))
        Always(element, value);
}

void XmlWriter::IfSet(Name element, Escaped value)
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
    if (isSet)
        PutLine('<', element, Name("/>"), kLineEnd);
}

void XmlWriter::Line(TextView text) { PutLine(text, kLineEnd); }

void XmlWriter::Line(Name before, Escaped value, Name after) { PutLine(before, value, after, kLineEnd); }

void XmlWriter::AlwaysWithAttribute(Name element, Name attribute, TextView about, TextView value)
{
    PutLine('<', element, ' ', attribute, Name("=\""), about, Name("\">"), value, Name("</"), element, '>', kLineEnd);
}

} // namespace varnex3
