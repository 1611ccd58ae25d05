// Values from one type to another: the one place that says which forms are accepted.
//
// | to         | from a text                                                                                     |
// |------------|-------------------------------------------------------------------------------------------------|
// | number     | blanks around, a sign, digits with a fraction (".5" and "5." too), an exponent with e or E.     |
// |            | No grouping, currency, hexadecimal, "inf" or "nan". The decimal separator is the full stop.     |
// | integer    | a number, rounded, halves to even                                                               |
// | date       | yyyy-mm-dd, alone or followed by a blank or T and hh:mm or hh:mm:ss; one digit will do for      |
// |            | month, day and hour; trailing blanks are ignored. Years 100 to 9999, days that exist.           |
// | Boolean    | "True" or "False" in any letter case, or a number: 0 is False                                   |
//
// The host's locale plays no part. Empty converts to "", 0, the zero date and False; the empty text converts to a text
// only. What does not convert raises TypeMismatch (13); a number outside its type Overflow (6). These errors name the
// value but have no source: the operation that converts adds it (Error::About).
#pragma once

#include <array>
#include <cstdint>
#include <optional>

#include "varnex3/core/Variant.h"

namespace varnex3 {

double NumberFrom(TextView text);
std::int16_t Int16From(TextView text);
std::int32_t Int32From(TextView text);
Date DateFrom(TextView text);

double ToDouble(const Variant& value);
std::int16_t ToInt16(const Variant& value);
std::int32_t ToInt32(const Variant& value);
bool ToBoolean(const Variant& value);

// A number becomes the date of that serial.
Date ToDate(const Variant& value);

// Numbers in the shortest decimal form that reads back the same; dates as "yyyy-mm-dd hh:mm:ss" (without the time at
// midnight); "True" and "False". A record is no text: TypeMismatch.
Text ToText(const Variant& value);

// An index as a position from 0, when it counts as numeric: a number, a Boolean, Empty, or a text that is a number.
// Nothing otherwise: the index is then a key. Raises Overflow for a number outside 32 bits.
std::optional<std::int32_t> PositionFrom(const Variant& index);

// A count as a 16-bit integer; raises Overflow above 32,767.
std::int16_t CountOf(std::size_t count, Name operation);

// An amount with two decimals: "0.00". Rounded from the shortest decimal text that reads back as the same number,
// halves away from zero: 1.005 gives "1.01", -0.005 "-0.01"; zero has no sign. Raises Overflow for infinities and
// not-a-number.
Text FormatAmount(double amount);

// A number as FormatAmount and ToText give it, in room of its own: nothing is allocated.
class NumberText
{
public:
    explicit NumberText(std::int32_t value);

    // False, and no text, for the amounts that FormatAmount has to look at more closely: very large ones and those near
    // the middle of two hundredths.
    NumberText() = default;
    bool PutAmount(double amount);

    TextView View() const { return {room.data() + start, room.size() - start}; }

private:
    void PutDigits(std::uint64_t value);
    void PutPair(std::uint64_t value);
    void Put(char character) { room[--start] = static_cast<char16_t>(character); }

    static constexpr std::size_t kRoom = 24;
    std::array<char16_t, kRoom> room; // NOLINT(cppcoreguidelines-pro-type-member-init): filled from its end
    std::size_t start = kRoom;
};

} // namespace varnex3
