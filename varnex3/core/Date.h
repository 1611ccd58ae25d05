// Dates as automation counts them: days since 30 December 1899, the fraction is the time of day.
#pragma once

#include <cstdint>
#include <optional>

#include "varnex3/core/Text.h"

namespace varnex3 {

// A date and time of day without a zone. The zero date, 30 December 1899 at midnight, means "not set" in optional
// elements. Below zero the time counts forward from the day: -1.25 is 29 December 1899, 06:00.
struct Date
{
    double serial = 0;

    friend constexpr bool operator==(Date, Date) = default;
};

// A date taken apart: years 100 to 9999, months and days from 1, 24-hour clock.
struct CivilDate
{
    std::int32_t year = 1899;
    std::int32_t month = 12;
    std::int32_t day = 30;
    std::int32_t hour = 0;
    std::int32_t minute = 0;
    std::int32_t second = 0;

    friend constexpr bool operator==(const CivilDate&, const CivilDate&) = default;
};

// The date of these fields; nothing when there is no such day or time, or the year is outside 100 to 9999.
// DateFrom({2004, 3, 15, 14, 5, 9}) is the serial 38061.586909...
std::optional<Date> DateFrom(const CivilDate& civil);

// A date taken apart, rounded to the nearest second. Raises Overflow outside the years 100 to 9999, without a
// source.
CivilDate CivilFrom(Date date);

// A date is set when it is not the zero date.
constexpr bool IsSet(Date date) { return date.serial != 0; }
inline bool IsSet(TextView text) { return !text.empty(); }

} // namespace varnex3
