#include "varnex3/core/modFunctions.h"

namespace varnex3 {

VARNEX_MODULE_DEFINE(modFunctions);

namespace {

// The digits of a number, padded with zeros to a width.
Text Padded(std::int32_t number, std::size_t width)
{
    Text digits(width, u'0');
    for (std::size_t i = width; i-- > 0; number /= 10)
        digits[i] = static_cast<char16_t>(u'0' + number % 10);
    return digits;
}

CivilDate CivilFor(Name operation, Date date)
{
    try {
        return CivilFrom(date);
    } catch (const Error& error) {
        throw error.About(operation, {});
    }
}

} // namespace

Text FormatDate(Date value, std::int32_t style)
{
    if (style < 0 || style > 3)
        return {};
    const CivilDate civil = CivilFor("modFunctions.FormatDate", value);
    const Text year = Padded(civil.year, 4);
    const Text month = Padded(civil.month, 2);
    const Text day = Padded(civil.day, 2);
    switch (style) {
    case 0:
        return year + u"-" + month + u"-" + day;
    case 1:
        return year + u"-" + month + u"-" + day + u"T" + Padded(civil.hour, 2) + u":" + Padded(civil.minute, 2) + u":"
               + Padded(civil.second, 2);
    case 2:
        return day + u"/" + month + u"/" + year.substr(2);
    default:
        return day + u"/" + month + u"/" + year;
    }
}

Text EscapeXML(TextView text)
{
    Text escaped;
    escaped.reserve(text.size());
    for (const char16_t c : text) {
        switch (c) {
        case u'&':
            escaped += u"&amp;";
            break;
        case u'<':
            escaped += u"&lt;";
            break;
        case u'>':
            escaped += u"&gt;";
            break;
        case u'\'':
            escaped += u"&apos;";
            break;
        case u'"':
            escaped += u"&quot;";
            break;
        default:
            escaped += c;
        }
    }
    return escaped;
}

bool SplitDateTime(TextView text, Text& datePart, Text& timePart, Text& zonePart)
{
    constexpr std::size_t kDateLength = 10;
    const std::size_t t = text.find_first_of(u"Tt");
    const std::size_t plus = text.find(u'+');
    datePart = text.substr(0, kDateLength);
    if (t != TextView::npos && plus != TextView::npos && plus < t)
        Raise(ErrorNumber::InvalidArgument, "modFunctions.SplitDateTime",
              Quoted(text) + u" has its time zone before its time");
    if (t != TextView::npos)
        timePart = text.substr(t + 1, plus == TextView::npos ? plus : plus - t - 1);
    if (plus != TextView::npos)
        zonePart = text.substr(plus + 1);
    return false;
}

} // namespace varnex3
