#include "varnex3/core/modFunctions.h"

#include "varnex3/core/Escaped.h"

namespace varnex3 {

VARNEX_MODULE_DEFINE(modFunctions);

namespace {

CivilDate CivilFor(Name operation, Date date)
{
    try {
        return CivilFrom(date);
    } catch (const Error& error) {
        throw error.About(operation, {});
    }
}

} // namespace

DateText::DateText(Date value, std::int32_t style)
{
    if (style < 0 || style > 3)
        return;
    const CivilDate civil = CivilFor("modFunctions.FormatDate", value);
    if (style > 1) {
        Put(civil.day, 2).Put(u'/').Put(civil.month, 2).Put(u'/').Put(civil.year, style == 2 ? 2 : 4);
        return;
    }
    Put(civil.year, 4).Put(u'-').Put(civil.month, 2).Put(u'-').Put(civil.day, 2);
    if (style == 1)
        Put(u'T').Put(civil.hour, 2).Put(u':').Put(civil.minute, 2).Put(u':').Put(civil.second, 2);
}

DateText& DateText::Put(char16_t character)
{
    room[length++] = character;
    return *this;
}

// The last digits of a number, zeros in front.
DateText& DateText::Put(std::int32_t number, std::size_t digits)
{
    length += digits;
    for (std::size_t i = length; digits > 0; --digits, number /= 10)
        room[--i] = static_cast<char16_t>(u'0' + number % 10);
    return *this;
}

Text FormatDate(Date value, std::int32_t style) { return Text(DateText(value, style).View()); }

Text EscapeXML(TextView text)
{
    const Escaped escaped(text);
    Text result(escaped.Length(), u'\0');
    escaped.Put(result.data());
    return result;
}

DateTimeParts::DateTimeParts(TextView text) : date(text.substr(0, kDateLength))
{
    const std::size_t t = text.find_first_of(u"Tt");
    const std::size_t plus = text.find(u'+');
    if (t != TextView::npos && plus != TextView::npos && plus < t)
        Raise(ErrorNumber::InvalidArgument, "modFunctions.SplitDateTime",
              Quoted(text) + u" has its time zone before its time");
    if (t != TextView::npos)
        time = text.substr(t + 1, plus == TextView::npos ? plus : plus - t - 1);
    if (plus != TextView::npos)
        zone = text.substr(plus + 1);
}

bool SplitDateTime(TextView text, Text& datePart, Text& timePart, Text& zonePart)
{
    datePart = text.substr(0, DateTimeParts::kDateLength); // set even where the rest raises
    const DateTimeParts parts(text);
    if (parts.time)
        timePart = *parts.time;
    if (parts.zone)
        zonePart = *parts.zone;
    return false;
}

} // namespace varnex3
