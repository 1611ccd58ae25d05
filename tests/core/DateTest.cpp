#include "varnex3/core/Date.h"

#include <limits>

#include "tests/Printing.h"
#include "varnex3/core/modFunctions.h"

using namespace varnex3;
using tests::RaisedBy;

namespace {

// The next day by the calendar's own words.
void GoToNextDay(CivilDate& date)
{
    const bool isLeapYear = (date.year % 4 == 0 && date.year % 100 != 0) || date.year % 400 == 0;
    const std::int32_t lengths[] = {31, isLeapYear ? 29 : 28, 31, 30, 31, 30, 31, 31, 30, 31, 30, 31};
    if (++date.day <= lengths[date.month - 1])
        return;
    date.day = 1;
    if (++date.month <= 12)
        return;
    date.month = 1;
    ++date.year;
}

CivilDate Midnight(std::int32_t year, std::int32_t month, std::int32_t day) { return {year, month, day, 0, 0, 0}; }

} // namespace

TEST_CASE("DateFrom: days are counted from 30 December 1899")
{
    CHECK(DateFrom(Midnight(1899, 12, 30)) == Date{0});
    CHECK(DateFrom(Midnight(1900, 1, 1)) == Date{2});
    CHECK(DateFrom(Midnight(1900, 3, 1)) == Date{61}); // 1900 was no leap year
    CHECK(DateFrom(Midnight(2004, 3, 15)) == Date{38061});
    CHECK(DateFrom(Midnight(100, 1, 1)) == Date{-657434});
    CHECK(DateFrom(Midnight(9999, 12, 31)) == Date{2958465});
}

TEST_CASE("Every day of the years 100 to 9999, there and back")
{
    CivilDate day = Midnight(100, 1, 1);
    std::int32_t wrong = 0;
    for (double serial = -657434; serial <= 2958465; ++serial, GoToNextDay(day))
        wrong += CivilFrom(Date{serial}) != day || DateFrom(day) != Date{serial};
    CHECK(wrong == 0);
    CHECK(day == Midnight(10000, 1, 1));
}

TEST_CASE("Every second of a day, there and back, on both sides of the zero date")
{
    std::int32_t wrong = 0;
    for (const CivilDate& start : {Midnight(2004, 3, 15), Midnight(1899, 12, 30), Midnight(1800, 2, 28)})
        for (std::int32_t second = 0; second < 86400; ++second) {
            CivilDate time = start;
            time.hour = second / 3600;
            time.minute = second / 60 % 60;
            time.second = second % 60;
            wrong += CivilFrom(*DateFrom(time)) != time;
        }
    CHECK(wrong == 0);
}

TEST_CASE("Below zero the time counts forward from the day")
{
    CHECK(CivilFrom(Date{-1.25}) == CivilDate{1899, 12, 29, 6, 0, 0});
    CHECK(DateFrom(CivilDate{1899, 12, 29, 6, 0, 0}) == Date{-1.25});
    CHECK(CivilFrom(Date{-0.25}) == CivilDate{1899, 12, 30, 6, 0, 0});
}

TEST_CASE("CivilFrom: rounded to the nearest second, the day with it")
{
    CHECK(CivilFrom(Date{38061 + 0.4 / 86400}) == Midnight(2004, 3, 15));
    CHECK(CivilFrom(Date{38061 + 0.6 / 86400}) == CivilDate{2004, 3, 15, 0, 0, 1});
    CHECK(CivilFrom(Date{38061 + 86399.6 / 86400}) == Midnight(2004, 3, 16));
    CHECK(CivilFrom(Date{-2 - 86399.6 / 86400}) == Midnight(1899, 12, 29));
}

TEST_CASE("DateFrom: nothing for a day or time that does not exist")
{
    for (const CivilDate& date :
         {Midnight(99, 12, 31), Midnight(10000, 1, 1), Midnight(2004, 0, 1), Midnight(2004, 13, 1),
          Midnight(2004, 4, 31), Midnight(2004, 4, 0), Midnight(2005, 2, 29), Midnight(1900, 2, 29),
          CivilDate{2004, 1, 1, 24, 0, 0}, CivilDate{2004, 1, 1, -1, 0, 0}, CivilDate{2004, 1, 1, 0, 60, 0},
          CivilDate{2004, 1, 1, 0, 0, 60}})
        CHECK_FALSE(DateFrom(date).has_value());
    CHECK(DateFrom(Midnight(2000, 2, 29)).has_value());
}

TEST_CASE("CivilFrom: outside the years 100 to 9999 an overflow")
{
    CHECK(RaisedBy([] { CivilFrom(Date{-657435}); }) == "6");
    CHECK(RaisedBy([] { CivilFrom(Date{2958466}); }) == "6");
    CHECK(RaisedBy([] { CivilFrom(Date{2958465.999999}); }) == "6"); // rounded, it is the year 10000
    CHECK(RaisedBy([] { CivilFrom(Date{std::numeric_limits<double>::infinity()}); }) == "6");
    CHECK(RaisedBy([] { CivilFrom(Date{std::numeric_limits<double>::quiet_NaN()}); }) == "6");
    CHECK(CivilFrom(Date{-657434.5}) == CivilDate{100, 1, 1, 12, 0, 0});
}

TEST_CASE("FormatDate: an overflow is its own, and any other style looks at no date")
{
    CHECK(RaisedBy([] { FormatDate(Date{1e9}, 0); }) == "6 modFunctions.FormatDate");
    CHECK(FormatDate(Date{1e9}, 4) == u"");
}

TEST_CASE("IsSet: any date but the zero date")
{
    CHECK_FALSE(IsSet(Date{}));
    CHECK(IsSet(Date{0.5}));
    CHECK(IsSet(Date{-1}));
}
