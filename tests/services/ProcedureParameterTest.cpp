// What a text becomes for each declared type.
#include "varnex3/services/ProcedureParameter.h"

#include "tests/Printing.h"

using namespace varnex3;
using tests::RaisedBy;

namespace {

constexpr int kMoments[] = {7, 133, 134, 135};

Variant Given(int type, TextView text, std::int64_t size = 0)
{
    return ConvertedText(text, static_cast<DatabaseType>(type), size);
}

} // namespace

TEST_CASE("Small and 32-bit integers take 16 bits: rounded, 0 for what is no number, an overflow outside")
{
    for (const int type : {2, 3, 16, 17, 19}) {
        CHECK(Given(type, u"12") == Variant(std::int16_t{12}));
        CHECK(Given(type, u" -2.5 ") == Variant(std::int16_t{-2}));
        CHECK(Given(type, u"32767") == Variant(std::int16_t{32767}));
        CHECK(Given(type, u"-32768") == Variant(std::int16_t{-32768}));
        for (const TextView text : {u"", u"12x", u"1,000", u"0x10", u"True", u"nan"})
            CHECK(Given(type, text) == Variant(std::int16_t{0}));
        CHECK(RaisedBy([&] { Given(type, u"32768"); }) == "6");
        CHECK(RaisedBy([&] { Given(type, u"-32768.6"); }) == "6");
        CHECK(RaisedBy([&] { Given(type, u"1e999"); }) == "6");
    }
}

TEST_CASE("64-bit integers take 32 bits")
{
    for (const int type : {20, 21}) {
        CHECK(Given(type, u"2147483647") == Variant(std::int32_t{2147483647}));
        CHECK(Given(type, u"abc") == Variant(std::int32_t{0}));
        CHECK(RaisedBy([&] { Given(type, u"2147483648"); }) == "6");
    }
}

TEST_CASE("Fractions take a double, 0 for what is no number")
{
    for (const int type : {4, 5, 131}) {
        CHECK(Given(type, u"3.14") == Variant(3.14));
        CHECK(Given(type, u"-1e3") == Variant(-1000.0));
        CHECK(Given(type, u"3,14") == Variant(0.0));
    }
}

TEST_CASE("Dates take a date; what is none gives no value")
{
    for (const int type : kMoments) {
        CHECK(Given(type, u"2004-03-15 14:05:09") == Variant(*DateFrom(CivilDate{2004, 3, 15, 14, 5, 9})));
        for (const TextView text : {u"", u"soon", u"15/03/2004", u"2004-02-30", u"0099-01-01", u"12"})
            CHECK(IsEmpty(Given(type, text)));
    }
}

TEST_CASE("A Boolean is read without a test")
{
    CHECK(Given(11, u"true") == Variant(true));
    CHECK(Given(11, u"False") == Variant(false));
    CHECK(Given(11, u"-1") == Variant(true));
    CHECK(Given(11, u"0") == Variant(false));
    CHECK(RaisedBy([] { Given(11, u"yes"); }) == "13");
    CHECK(RaisedBy([] { Given(11, u""); }) == "13");
}

TEST_CASE("Texts are cut to the declared size unless that is unlimited; other types take the text as it is")
{
    for (const int type : {129, 200}) {
        CHECK(Given(type, u"ABC", 2) == Variant(Text(u"AB")));
        CHECK(Given(type, u"ABC", 3) == Variant(Text(u"ABC")));
        CHECK(Given(type, u"", 2) == Variant(Text()));
        CHECK(Given(type, u"ABC", kUnlimitedSize) == Variant(Text(u"ABC")));
    }
    for (const int type : {12, 18, 72, 128, 130, 201, 202, 203, 204, 205, 6, 0})
        CHECK(Given(type, u"ABC", 2) == Variant(Text(u"ABC")));
}

TEST_CASE("A driver's type codes are those of classic clients")
{
    struct Row
    {
        std::int16_t odbcType;
        const char16_t* name;
        std::int16_t type;
    };
    for (const Row& row : {Row{-7, u"bit", 11},
                           Row{-6, u"tinyint", 17},
                           Row{5, u"smallint", 2},
                           Row{4, u"int", 3},
                           Row{4, u"int unsigned", 19},
                           Row{-5, u"bigint", 20},
                           Row{-5, u"bigint unsigned", 21},
                           Row{7, u"real", 4},
                           Row{6, u"float", 5},
                           Row{2, u"numeric", 131},
                           Row{3, u"money", 131},
                           Row{1, u"char", 129},
                           Row{12, u"varchar", 200},
                           Row{-1, u"text", 201},
                           Row{-8, u"nchar", 130},
                           Row{-9, u"nvarchar", 202},
                           Row{-10, u"ntext", 203},
                           Row{91, u"date", 133},
                           Row{92, u"time", 134},
                           Row{93, u"datetime", 135},
                           Row{-11, u"uniqueidentifier", 72},
                           Row{-2, u"binary", 128},
                           Row{-150, u"sql_variant", 12}})
        CHECK(static_cast<std::int16_t>(DatabaseTypeOf(row.odbcType, row.name)) == row.type);
}
