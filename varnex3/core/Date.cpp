#include "varnex3/core/Date.h"

#include <cmath>

#include "varnex3/core/Error.h"

namespace varnex3 {

namespace {

constexpr std::int64_t kSecondsPerDay = 86400;
constexpr double kFirstSerial = -657434;     // 1 January 100
constexpr double kAfterLastSerial = 2958466; // 1 January 10000

constexpr bool IsLeapYear(std::int32_t year) { return year % 4 == 0 && (year % 100 != 0 || year % 400 == 0); }

constexpr std::int32_t DaysInMonth(std::int32_t year, std::int32_t month)
{
    constexpr std::int32_t days[] = {31, 28, 31, 30, 31, 30, 31, 31, 30, 31, 30, 31};
    return month == 2 && IsLeapYear(year) ? 29 : days[month - 1];
}

// Days from 1 March of the year 0 to a day of the proleptic Gregorian calendar: with March first, the leap day is
// the last day of its year.
constexpr std::int64_t DaysFromCivil(std::int32_t year, std::int32_t month, std::int32_t day)
{
    const std::int64_t y = month <= 2 ? year - 1 : year;
    const std::int64_t monthFromMarch = (month + 9) % 12;
    const std::int64_t dayOfYear = (153 * monthFromMarch + 2) / 5 + day - 1;
    return y * 365 + y / 4 - y / 100 + y / 400 + dayOfYear;
}

constexpr std::int64_t kZeroDay = DaysFromCivil(1899, 12, 30);

constexpr void SetDay(CivilDate& civil, std::int64_t daysFromMarch)
{
    constexpr std::int64_t kDaysInEra = 146097; // 400 years
    const std::int64_t era = daysFromMarch / kDaysInEra;
    const std::int64_t dayOfEra = daysFromMarch % kDaysInEra;
    const std::int64_t yearOfEra = (dayOfEra - dayOfEra / 1460 + dayOfEra / 36524 - dayOfEra / 146096) / 365;
    const std::int64_t dayOfYear = dayOfEra - (365 * yearOfEra + yearOfEra / 4 - yearOfEra / 100);
    const std::int64_t monthFromMarch = (5 * dayOfYear + 2) / 153;
    civil.day = static_cast<std::int32_t>(dayOfYear - (153 * monthFromMarch + 2) / 5 + 1);
    civil.month = static_cast<std::int32_t>(monthFromMarch < 10 ? monthFromMarch + 3 : monthFromMarch - 9);
    civil.year = static_cast<std::int32_t>(yearOfEra + era * 400 + (civil.month <= 2 ? 1 : 0));
}

bool IsValid(const CivilDate& civil)
{
    return civil.year >= 100 && civil.year <= 9999 && civil.month >= 1 && civil.month <= 12 && civil.day >= 1
           && civil.day <= DaysInMonth(civil.year, civil.month) && civil.hour >= 0 && civil.hour <= 23
           && civil.minute >= 0 && civil.minute <= 59 && civil.second >= 0 && civil.second <= 59;
}

} // namespace

std::optional<Date> DateFrom(const CivilDate& civil)
{
    if (!IsValid(civil))
        return std::nullopt;
    const auto day = static_cast<double>(DaysFromCivil(civil.year, civil.month, civil.day) - kZeroDay);
    const double time = (civil.hour * 3600 + civil.minute * 60 + civil.second) / static_cast<double>(kSecondsPerDay);
    return Date{day < 0 ? day - time : day + time}; // below zero the time counts forward from the day
}

CivilDate CivilFrom(Date date)
{
    const double day = std::trunc(date.serial);
    const double time = std::abs(date.serial - day);
    const bool isInRange = day >= kFirstSerial && date.serial < kAfterLastSerial; // false for not-a-number, too
    if (!isInRange)
        throw Error(ErrorNumber::Overflow, {}, u"a date outside the years 100 to 9999");
    const std::int64_t seconds = std::llround(time * kSecondsPerDay);
    const std::int64_t days = static_cast<std::int64_t>(day) + kZeroDay + seconds / kSecondsPerDay;
    const auto secondOfDay = static_cast<std::int32_t>(seconds % kSecondsPerDay);
    if (days >= static_cast<std::int64_t>(kAfterLastSerial) + kZeroDay)
        throw Error(ErrorNumber::Overflow, {}, u"a date outside the years 100 to 9999");
    CivilDate civil;
    SetDay(civil, days);
    civil.hour = secondOfDay / 3600;
    civil.minute = secondOfDay / 60 % 60;
    civil.second = secondOfDay % 60;
    return civil;
}

} // namespace varnex3
