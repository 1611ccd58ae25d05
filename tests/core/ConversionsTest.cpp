#include "varnex3/core/Conversions.h"

#include <cmath>
#include <limits>
#include <locale>
#include <random>

#include "tests/Printing.h"
#include "varnex3/core/VersionDef.h"

using namespace varnex3;
using tests::RaisedBy;

namespace {

constexpr double kInfinity = std::numeric_limits<double>::infinity();
constexpr double kNotANumber = std::numeric_limits<double>::quiet_NaN();

// A host that writes 1.234,5.
struct CommaPunctuation : std::numpunct<char>
{
    char do_decimal_point() const override { return ','; }
    char do_thousands_sep() const override { return '.'; }
    std::string do_grouping() const override { return "\3"; }
};

struct CommaLocale
{
    std::locale before = std::locale::global(std::locale(std::locale(), new CommaPunctuation));
    ~CommaLocale() { std::locale::global(before); }
};

} // namespace

TEST_CASE("NumberFrom: sign, digits, fraction and exponent, with blanks around")
{
    CHECK(NumberFrom(u"0") == 0);
    CHECK(NumberFrom(u"-12") == -12);
    CHECK(NumberFrom(u"+12.50") == 12.5);
    CHECK(NumberFrom(u".5") == 0.5);
    CHECK(NumberFrom(u"5.") == 5);
    CHECK(NumberFrom(u"-.5e1") == -5);
    CHECK(NumberFrom(u"1E3") == 1000);
    CHECK(NumberFrom(u"25e-2") == 0.25);
    CHECK(NumberFrom(u"1e+2") == 100);
    CHECK(NumberFrom(u"  7  ") == 7);
    CHECK(NumberFrom(u"000000000000000000000000000000012") == 12);
}

TEST_CASE("NumberFrom: reads the nearest double")
{
    CHECK(NumberFrom(u"0.1") == 0.1);
    CHECK(NumberFrom(u"1.7976931348623157e308") == std::numeric_limits<double>::max());
    CHECK(NumberFrom(u"2.2250738585072014E-308") == std::numeric_limits<double>::min());
    CHECK(NumberFrom(u"9007199254740993") == 9007199254740992.0);
}

TEST_CASE("NumberFrom: a number too small for a double is 0, one too large an overflow")
{
    CHECK(NumberFrom(u"1e-999") == 0);
    CHECK(NumberFrom(u"0." + Text(400, u'0') + u"1") == 0);
    CHECK(NumberFrom(u"-1e-99999999999") == 0);
    CHECK(NumberFrom(u"0e999999999999") == 0);
    CHECK(NumberFrom(u"0.000e99999") == 0);
    CHECK(RaisedBy([] { NumberFrom(u"1e999"); }) == "6");
    CHECK(RaisedBy([] { NumberFrom(u"-1e999"); }) == "6");
    CHECK(RaisedBy([] { NumberFrom(u"1e99999999999"); }) == "6");
    CHECK(RaisedBy([] { NumberFrom(Text(400, u'9')); }) == "6");
    CHECK(NumberFrom(Text(400, u'9') + u"e-399") == doctest::Approx(10));
    CHECK(NumberFrom(u"0." + Text(400, u'0') + u"1e401") == 1);
}

TEST_CASE("NumberFrom: everything else is a type mismatch")
{
    for (const TextView text :
         {u"",         u" ",   u"+",  u"-",   u".",   u"e1",      u"1e",     u"1e+",    u"1e1.5", u"1,5",  u"1,000",
          u"1 000",    u"$1",  u"1%", u"(1)", u"--1", u"1-",      u"0x10",   u"&H10",   u"inf",   u"-INF", u"nan",
          u"infinity", u"1d2", u"1f", u"\t1", u"1\n", u"\u00A01", u"\u0661", u"\uFF11", u"one",   u"True"}) {
        CAPTURE(Text(text));
        CHECK(RaisedBy([&] { NumberFrom(text); }) == "13");
    }
    CHECK(RaisedBy([] { NumberFrom(TextView(u"1\0", 2)); }) == "13");
}

TEST_CASE("Numbers have a full stop, whatever the host's locale")
{
    const CommaLocale comma;
    CHECK(NumberFrom(u"1.5") == 1.5);
    CHECK(RaisedBy([] { NumberFrom(u"1,5"); }) == "13");
    CHECK(NumberFrom(u"0." + Text(400, u'0') + u"1e390") == 1e-11);
    CHECK(ToText(Variant(1234567.5)) == u"1234567.5");
    CHECK(FormatAmount(1234567.5) == u"1234567.50");
    CHECK(ToText(Variant(std::int32_t{1234567})) == u"1234567");
}

TEST_CASE("ToInt16 and ToInt32: rounded, halves to even")
{
    CHECK(ToInt32(0.5) == 0);
    CHECK(ToInt32(1.5) == 2);
    CHECK(ToInt32(2.5) == 2);
    CHECK(ToInt32(-0.5) == 0);
    CHECK(ToInt32(-1.5) == -2);
    CHECK(ToInt32(-2.5) == -2);
    CHECK(ToInt32(2.5000001) == 3);
    CHECK(ToInt16(Text(u"32766.5")) == 32766);
    CHECK(ToInt16(Text(u"-7.5")) == -8);
}

TEST_CASE("ToInt16 and ToInt32: what is outside the type after rounding is an overflow")
{
    CHECK(ToInt16(32767.4) == 32767);
    CHECK(ToInt16(-32768.5) == -32768);
    CHECK(RaisedBy([] { ToInt16(32767.5); }) == "6");
    CHECK(RaisedBy([] { ToInt16(-32768.6); }) == "6");
    CHECK(ToInt32(2147483647.4) == 2147483647);
    CHECK(ToInt32(-2147483648.5) == std::numeric_limits<std::int32_t>::min());
    CHECK(RaisedBy([] { ToInt32(2147483647.5); }) == "6");
    CHECK(RaisedBy([] { ToInt32(-2147483648.6); }) == "6");
    CHECK(RaisedBy([] { ToInt32(kInfinity); }) == "6");
    CHECK(RaisedBy([] { ToInt32(kNotANumber); }) == "6");
}

TEST_CASE("ToDouble: Empty is 0, True is -1, a date its serial")
{
    CHECK(ToDouble(Empty) == 0);
    CHECK(ToDouble(true) == -1);
    CHECK(ToDouble(false) == 0);
    CHECK(ToDouble(Date{1.5}) == 1.5);
    CHECK(ToDouble(std::int16_t{-3}) == -3);
    CHECK(RaisedBy([] { ToDouble(Ref<Record>(New<VersionDef>())); }) == "13");
    CHECK(RaisedBy([] { ToDouble(Ref<Record>()); }) == "13");
}

TEST_CASE("ToBoolean: True and False in any letter case, and numbers: 0 is False")
{
    CHECK(ToBoolean(Text(u"True")));
    CHECK(ToBoolean(Text(u"tRUE")));
    CHECK_FALSE(ToBoolean(Text(u"FALSE")));
    CHECK(ToBoolean(Text(u"-1")));
    CHECK(ToBoolean(Text(u"0.1")));
    CHECK_FALSE(ToBoolean(Text(u" 0.0 ")));
    CHECK(ToBoolean(2.0));
    CHECK_FALSE(ToBoolean(Empty));
    CHECK_FALSE(ToBoolean(Date{}));
    for (const TextView text : {u"", u"yes", u"T", u" True", u"True "})
        CHECK(RaisedBy([&] { ToBoolean(Text(text)); }) == "13");
}

TEST_CASE("ToText: the shortest number that reads back the same")
{
    CHECK(ToText(Variant(0.1)) == u"0.1");
    CHECK(ToText(Variant(-2.0)) == u"-2");
    CHECK(ToText(Variant(1.0 / 3)) == u"0.3333333333333333");
    CHECK(ToText(Variant(std::int16_t{-32768})) == u"-32768");
    std::mt19937_64 random(1);
    for (int i = 0; i < 1000; ++i) {
        const double number = std::ldexp(static_cast<double>(random()), static_cast<int>(random() % 200) - 120);
        CHECK(NumberFrom(ToText(Variant(number))) == number);
    }
}

TEST_CASE("ToText: dates with their time, without it at midnight; True and False; Empty is nothing")
{
    CHECK(ToText(*DateFrom(CivilDate{2004, 3, 15, 14, 5, 9})) == u"2004-03-15 14:05:09");
    CHECK(ToText(*DateFrom(CivilDate{2004, 3, 15, 0, 0, 0})) == u"2004-03-15");
    CHECK(ToText(Variant(true)) == u"True");
    CHECK(ToText(Variant(false)) == u"False");
    CHECK(ToText(Empty) == u"");
    CHECK(RaisedBy([] { ToText(Ref<Record>(New<VersionDef>())); }) == "13");
    CHECK(RaisedBy([] { ToText(Ref<Record>()); }) == "13");
}

TEST_CASE("A date as text reads back to the same date")
{
    const Variant date = *DateFrom(CivilDate{2004, 3, 15, 14, 5, 9});
    CHECK(ToDate(ToText(date)) == std::get<Date>(date));
}

TEST_CASE("ToDate: Empty is the zero date; a number is the date of that serial, within the years 100 to 9999")
{
    CHECK(ToDate(Empty) == Date{});
    CHECK(ToDate(38061.5) == Date{38061.5});
    CHECK(ToDate(std::int32_t{-657434}) == Date{-657434});
    CHECK(RaisedBy([] { ToDate(std::int32_t{-657435}); }) == "6");
    CHECK(RaisedBy([] { ToDate(std::int32_t{2958466}); }) == "6");
    CHECK(RaisedBy([] { ToDate(kNotANumber); }) == "6");
}

TEST_CASE("PositionFrom: numbers, Booleans, Empty and texts that are numbers count as numeric")
{
    CHECK(PositionFrom(std::int32_t{3}) == 3);
    CHECK(PositionFrom(2.5) == 2);
    CHECK(PositionFrom(true) == -1);
    CHECK(PositionFrom(Empty) == 0);
    CHECK(PositionFrom(Text(u" 3 ")) == 3);
    CHECK(PositionFrom(Text(u"3.5")) == 4);
    CHECK(PositionFrom(Text(u"-1e1")) == -10);
}

TEST_CASE("PositionFrom: any other text is a key; a number outside 32 bits is an overflow")
{
    CHECK_FALSE(PositionFrom(Text(u"")));
    CHECK_FALSE(PositionFrom(Text(u"a.xml")));
    CHECK_FALSE(PositionFrom(Text(u"True")));
    CHECK_FALSE(PositionFrom(Text(u"1,5")));
    CHECK(RaisedBy([] { PositionFrom(Text(u"2147483648")); }) == "6");
    CHECK(RaisedBy([] { PositionFrom(Text(u"1e999")); }) == "6");
    CHECK(RaisedBy([] { PositionFrom(kInfinity); }) == "6");
}

TEST_CASE("CountOf: more than 32,767 is an overflow of the operation")
{
    CHECK(CountOf(32767, "List.Count") == 32767);
    CHECK(RaisedBy([] { CountOf(32768, "List.Count"); }) == "6 List.Count");
    CHECK(RaisedBy([] { CountOf(65536, "List.Count"); }) == "6 List.Count");
}

TEST_CASE("FormatAmount: two decimals, halves away from zero as the decimal text has them")
{
    CHECK(FormatAmount(0) == u"0.00");
    CHECK(FormatAmount(1.005) == u"1.01"); // although the double is a little less
    CHECK(FormatAmount(149.625) == u"149.63");
    CHECK(FormatAmount(-0.005) == u"-0.01");
    CHECK(FormatAmount(2.675) == u"2.68");
    CHECK(FormatAmount(0.615) == u"0.62");
    CHECK(FormatAmount(1.0049999) == u"1.00");
    CHECK(FormatAmount(10) == u"10.00");
    CHECK(FormatAmount(1234.5) == u"1234.50");
}

TEST_CASE("FormatAmount: every thousandth is rounded as its digits say")
{
    int wrong = 0;
    for (std::int32_t thousandths = 0; thousandths < 300000; ++thousandths) {
        const std::int32_t hundredths = (thousandths + 5) / 10;
        const std::string digits = std::to_string(1000 + hundredths % 100).substr(2);
        wrong += FormatAmount(thousandths / 1000.0) != ToUtf16(std::to_string(hundredths / 100) + "." + digits);
    }
    CHECK(wrong == 0);
}

TEST_CASE("NumberFrom: plain digits with a point give the nearest double, as the long way does")
{
    int wrong = 0;
    for (std::int32_t i = 0; i < 100000; ++i) {
        const std::string digits = std::to_string(i * 7919LL);
        const std::string text = digits.substr(0, digits.size() / 2) + "." + digits.substr(digits.size() / 2);
        wrong += NumberFrom(ToUtf16(text)) != NumberFrom(ToUtf16(text + "e0")); // an exponent goes the long way
    }
    CHECK(wrong == 0);
    CHECK(NumberFrom(u"007.50") == 7.5);
    CHECK(NumberFrom(u"123456789012345") == 123456789012345.0);
    CHECK(NumberFrom(u"0.1234567890123456789") == 0.1234567890123456789);
}

TEST_CASE("FormatAmount: the carry runs as far as it must")
{
    CHECK(FormatAmount(0.995) == u"1.00");
    CHECK(FormatAmount(9.999) == u"10.00");
    CHECK(FormatAmount(-999.995) == u"-1000.00");
    CHECK(FormatAmount(99999999.999) == u"100000000.00");
}

TEST_CASE("FormatAmount: a result of zero has no sign")
{
    CHECK(FormatAmount(-0.001) == u"0.00");
    CHECK(FormatAmount(-0.0) == u"0.00");
    CHECK(FormatAmount(-0.00499) == u"0.00");
    CHECK(FormatAmount(std::numeric_limits<double>::denorm_min()) == u"0.00");
}

TEST_CASE("FormatAmount: large amounts keep the plain form, without grouping")
{
    CHECK(FormatAmount(1e15) == u"1000000000000000.00");
    CHECK(FormatAmount(1e21) == u"1000000000000000000000.00");
    CHECK(FormatAmount(-1234567890123.45) == u"-1234567890123.45");
    CHECK(FormatAmount(1e300).size() == 304);
}

TEST_CASE("FormatAmount: infinite and not-a-number are an overflow")
{
    CHECK(RaisedBy([] { FormatAmount(kInfinity); }) == "6");
    CHECK(RaisedBy([] { FormatAmount(-kInfinity); }) == "6");
    CHECK(RaisedBy([] { FormatAmount(kNotANumber); }) == "6");
}

TEST_CASE("FormatAmount: agrees with whole-number arithmetic on thousandths")
{
    std::mt19937_64 random(2);
    for (int i = 0; i < 20000; ++i) {
        const auto thousandths = static_cast<std::int64_t>(random() % 2000000000) - 1000000000;
        const std::int64_t hundredths = (std::abs(thousandths) + 5) / 10;
        const std::string digits = std::to_string(hundredths + 100); // three digits at least
        std::string expected = std::to_string(hundredths / 100) + "." + digits.substr(digits.size() - 2);
        if (thousandths < 0 && hundredths != 0)
            expected.insert(0, 1, '-');
        CHECK(ToUtf8(FormatAmount(static_cast<double>(thousandths) / 1000)) == expected);
    }
}

TEST_CASE("A conversion's error names the value and has no source until the operation adds it")
{
    try {
        NumberFrom(u"12x");
        FAIL("12x is no number");
    } catch (const Error& error) {
        CHECK(error.Source() == u"");
        CHECK(error.Description() == u"'12x' is not a number");
        const Error about = error.About("QuoteItem.ParseXML", u"ItemNo");
        CHECK(about.Source() == u"QuoteItem.ParseXML");
        CHECK(about.Description() == u"ItemNo: '12x' is not a number");
        CHECK(about.About("Other.Operation", u"Other").Source() == u"QuoteItem.ParseXML");
    }
}

TEST_CASE("A long value is cut in a description")
{
    CHECK(Quoted(Text(60, u'x')) == u"'" + Text(60, u'x') + u"'");
    CHECK(Quoted(Text(61, u'x')) == u"'" + Text(60, u'x') + u"...'");
}
