// Dates as text, the parts of an ISO date-time, and escaping.
#pragma once

#include <array>
#include <optional>

#include "varnex3/core/Rows.h"

namespace varnex3 {

VARNEX_MODULE(modFunctions, "Dates as text, the parts of an ISO date-time, and escaping.");

VARNEX_FUNCTION(modFunctions, Text, FormatDate, (Date value, std::int32_t style),
                "A date as text: style 0 yyyy-mm-dd, 1 yyyy-mm-ddThh:mm:ss, 2 dd/mm/yy, 3 dd/mm/yyyy, 24-hour clock, "
                "rounded to the "
                "nearest second; any other style the empty text. Outside the years 100 to 9999 raises Overflow (6).");

VARNEX_FUNCTION(modFunctions, Text, EscapeXML, (TextView text),
                "The text with & < > ' and the double quote as entities; an entity in it is escaped once more.");

VARNEX_FUNCTION(
    modFunctions, bool, SplitDateTime, (TextView text, Text& datePart, Text& timePart, Text& zonePart),
    "Splits an ISO date-time: the first 10 characters; what stands between a T and a plus sign, or after the T; what "
    "stands after the plus sign. A part that is not there is left as it was. A plus sign before the T raises "
    "InvalidArgument (5). The result is always False.");

VARNEX_MODULE_END(modFunctions);

// What SplitDateTime finds, in the text itself; a part that is not there is not set.
struct DateTimeParts
{
    static constexpr std::size_t kDateLength = 10;

    explicit DateTimeParts(TextView text);
    TextView date;
    std::optional<TextView> time;
    std::optional<TextView> zone;
};

// A date as FormatDate gives it, in room of its own: nothing is allocated.
class DateText
{
public:
    DateText(Date value, std::int32_t style);
    TextView View() const { return {room.data(), length}; }

private:
    DateText& Put(char16_t character);
    DateText& Put(std::int32_t number, std::size_t digits);

    static constexpr std::size_t kLongest = 19; // 2004-03-15T14:05:09
    std::array<char16_t, kLongest> room;        // NOLINT(cppcoreguidelines-pro-type-member-init): as far as length says
    std::size_t length = 0;
};

} // namespace varnex3
