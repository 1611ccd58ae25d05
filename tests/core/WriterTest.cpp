#include "varnex3/core/XmlWriter.h"

#include <functional>

#include "tests/Printing.h"
#include "varnex3/core/ClaimHeaderDef.h"
#include "varnex3/core/CustomerDef.h"
#include "varnex3/core/PersonalNameDef.h"
#include "varnex3/core/modFunctions.h"

using namespace varnex3;
using tests::RaisedBy;

namespace {

template <int Level>
struct Written
{
    static constexpr int kLevel = Level;
    static constexpr Name ClassName = "Written";
    std::function<void(XmlWriter&)> write;
    void Write(XmlWriter& xml) const { write(xml); }
};

// What a record at this level writes.
template <int Level = 1>
Text TextOf(const std::function<void(XmlWriter&)>& write)
{
    return XmlWriter::TextOf(Written<Level>{write});
}

} // namespace

TEST_CASE("XmlWriter: a group's tags stand at its level, its lines one level deeper")
{
    CHECK(TextOf([](XmlWriter& xml) {
              xml.Open("A");
              xml.Always("B", u"x");
              xml.Open("C");
              xml.Always("D", u"");
              xml.Close("C");
              xml.Close("A");
          })
          == u"\t<A>\r\n\t\t<B>x</B>\r\n\t\t<C>\r\n\t\t\t<D></D>\r\n\t\t</C>\r\n\t</A>\r\n");
    CHECK(TextOf<0>([](XmlWriter& xml) { xml.Always("A", u"x"); }) == u"<A>x</A>\r\n");
    CHECK(TextOf<3>([](XmlWriter& xml) { xml.Always("A", u"x"); }) == u"\t\t\t<A>x</A>\r\n");
}

TEST_CASE("XmlWriter: nothing written is the empty text")
{
    CHECK(TextOf([](XmlWriter&) {}) == u"");
}

TEST_CASE("XmlWriter: values are written as they are")
{
    CHECK(TextOf([](XmlWriter& xml) { xml.Always("A", u"<&>\r\n"); }) == u"\t<A><&>\r\n</A>\r\n");
    CHECK(TextOf([](XmlWriter& xml) { xml.Always("A", TextView(u"\xD800\0x", 3)); })
          == u"\t<A>" + Text(u"\xD800\0x", 3) + u"</A>\r\n");
}

TEST_CASE("XmlWriter: Always writes dates as yyyy-mm-dd, amounts with two decimals, integers in plain decimal")
{
    CHECK(TextOf([](XmlWriter& xml) {
              xml.Always("A", *DateFrom(CivilDate{2004, 3, 15, 14, 5, 9}));
          })
          == u"\t<A>2004-03-15</A>\r\n");
    CHECK(TextOf([](XmlWriter& xml) { xml.Always("A", Date{}); }) == u"\t<A>1899-12-30</A>\r\n");
    CHECK(TextOf([](XmlWriter& xml) { xml.Always("A", 1234.5); }) == u"\t<A>1234.50</A>\r\n");
    CHECK(TextOf([](XmlWriter& xml) { xml.Always("A", std::int32_t{-1234}); }) == u"\t<A>-1234</A>\r\n");
}

TEST_CASE("XmlWriter: an amount or a date that cannot be written raises")
{
    CHECK(RaisedBy([] { TextOf([](XmlWriter& xml) { xml.Always("A", 1e308 * 10); }); }).starts_with("6"));
    CHECK(RaisedBy([] { TextOf([](XmlWriter& xml) { xml.Always("A", Date{1e9}); }); }).starts_with("6"));
}

TEST_CASE("XmlWriter: an amount that cannot be written is raised by the record that writes it, about its element")
{
    try {
        TextOf([](XmlWriter& xml) { xml.Always("Cost", 1e308 * 10); });
        FAIL("nothing was raised");
    } catch (const Error& error) {
        CHECK(error.Source() == u"Written.Serialise");
        CHECK(error.Description() == u"Cost: an amount that is not a finite number");
    }
}

TEST_CASE("XmlWriter: IfPositive leaves out what is not greater than 0")
{
    const auto written = [](double amount) { return TextOf([&](XmlWriter& xml) { xml.IfPositive("A", amount); }); };
    CHECK(written(0) == u"");
    CHECK(written(-1) == u"");
    CHECK(written(0.001) == u"\t<A>0.00</A>\r\n");
    CHECK(written(2) == u"\t<A>2.00</A>\r\n");
}

TEST_CASE("XmlWriter: a flag is an empty element, or nothing")
{
    CHECK(TextOf([](XmlWriter& xml) { xml.Flag("A", true); }) == u"\t<A/>\r\n");
    CHECK(TextOf([](XmlWriter& xml) { xml.Flag("A", false); }) == u"");
}

TEST_CASE("XmlWriter: IfSet leaves out the empty text and the zero date, and nothing else")
{
    CHECK(TextOf([](XmlWriter& xml) { xml.IfSet("A", u""); }) == u"");
    CHECK(TextOf([](XmlWriter& xml) { xml.IfSet("A", Date{}); }) == u"");
    CHECK(TextOf([](XmlWriter& xml) { xml.IfSet("A", u" "); }) == u"\t<A> </A>\r\n");
    CHECK(TextOf([](XmlWriter& xml) { xml.IfSet("A", Date{0.5}); }) == u"\t<A>1899-12-30</A>\r\n");
}

TEST_CASE("XmlWriter: a line with an attribute is written whatever the values, and neither is escaped")
{
    CHECK(TextOf([](XmlWriter& xml) { xml.AlwaysWithAttribute("A", "FieldName", u"B\"<", u"x&"); })
          == u"\t<A FieldName=\"B\"<\">x&</A>\r\n");
    CHECK(TextOf([](XmlWriter& xml) { xml.AlwaysWithAttribute("A", "FieldName", u"", u""); })
          == u"\t<A FieldName=\"\"></A>\r\n");
}

TEST_CASE("XmlWriter: a group with an attribute opens whatever the value, which is not escaped")
{
    CHECK(TextOf([](XmlWriter& xml) {
              xml.OpenWithAttribute("A", "Name", u"B\"<");
              xml.Always("C", u"x");
              xml.Close("A");
              xml.OpenWithAttribute("D", "Name", u"");
              xml.Close("D");
          })
          == u"\t<A Name=\"B\"<\">\r\n\t\t<C>x</C>\r\n\t</A>\r\n\t<D Name=\"\">\r\n\t</D>\r\n");
}

TEST_CASE("XmlWriter: a group that nothing is written inside is taken back")
{
    const auto group = [](XmlWriter& xml, TextView inside) {
        xml.Always("Before", u"1");
        const XmlWriter::Mark mark = xml.OpenUnlessEmpty("Group");
        xml.IfSet("Inside", inside);
        xml.CloseUnlessEmpty(mark);
        xml.Always("After", u"2");
    };
    CHECK(TextOf([&](XmlWriter& xml) { group(xml, u""); }) == u"\t<Before>1</Before>\r\n\t<After>2</After>\r\n");
    CHECK(TextOf([&](XmlWriter& xml) { group(xml, u"x"); })
          == u"\t<Before>1</Before>\r\n\t<Group>\r\n\t\t<Inside>x</Inside>\r\n\t</Group>\r\n\t<After>2</After>\r\n");
}

TEST_CASE("XmlWriter: groups that are taken back may stand inside each other")
{
    CHECK(TextOf([](XmlWriter& xml) {
              const XmlWriter::Mark outer = xml.OpenUnlessEmpty("Outer");
              const XmlWriter::Mark inner = xml.OpenUnlessEmpty("Inner");
              xml.CloseUnlessEmpty(inner);
              xml.CloseUnlessEmpty(outer);
              xml.Always("A", u"");
          })
          == u"\t<A></A>\r\n");
}

TEST_CASE("XmlWriter: a text of any length is whole, also where the first room ends")
{
    std::int32_t wrong = 0;
    for (std::size_t length = XmlWriter::kUsualRoom - 50; length < XmlWriter::kUsualRoom + 50; ++length) {
        const Text value(length, u'x');
        const Text text = TextOf([&](XmlWriter& xml) { xml.Always("A", value); });
        wrong += text != u"\t<A>" + value + u"</A>\r\n";
    }
    CHECK(wrong == 0);
}

TEST_CASE("XmlWriter: a group that is taken back where the first room ends leaves nothing")
{
    std::int32_t wrong = 0;
    for (std::size_t length = XmlWriter::kUsualRoom - 50; length < XmlWriter::kUsualRoom + 10; ++length) {
        const Text value(length, u'x');
        const Text text = TextOf([&](XmlWriter& xml) {
            xml.Always("A", value);
            xml.CloseUnlessEmpty(xml.OpenUnlessEmpty("Group"));
            xml.Always("B", u"y");
        });
        wrong += text != u"\t<A>" + value + u"</A>\r\n\t<B>y</B>\r\n";
    }
    CHECK(wrong == 0);
}

TEST_CASE("XmlWriter: a child stands at its own class's level, whatever stands around it")
{
    Child<ClaimHeaderDef> claim;
    claim->VehicleID(u"V");
    Child<PersonalNameDef> name;
    name->Surname(u"S");
    CHECK(
        TextOf<0>([&](XmlWriter& xml) {
            xml.Open("Root");
            xml.Append(claim);
            xml.Append(name);
            xml.Always("A", u"");
            xml.Close("Root");
        })
        == u"<Root>\r\n\t<ClaimHeader>\r\n\t\t<VehicleID>V</VehicleID>\r\n\t\t<ReinstatementNo>0</ReinstatementNo>\r\n"
           u"\t</ClaimHeader>\r\n\t\t<PersonalName>\r\n\t\t\t<Surname>S</Surname>\r\n\t\t</PersonalName>\r\n"
           u"\t<A></A>\r\n</Root>\r\n");
}

TEST_CASE("XmlWriter: several children are written one behind the other, in the order in which they are named")
{
    const Child<PersonalNameDef> name;
    name->Surname(u"S");
    const Child<CustomerDef> nobody; // writes nothing
    const Child<ClaimHeaderDef> claim;
    claim->VehicleID(u"V");
    CHECK(TextOf<0>([&](XmlWriter& xml) { xml.Append(name, nobody, claim); })
          == name->Serialise() + claim->Serialise());
}

TEST_CASE("XmlWriter: Writes tells whether a child would write anything")
{
    Child<PersonalNameDef> name;
    CHECK_FALSE(XmlWriter::Writes(name));
    name->HomePhone(u"1");
    CHECK(XmlWriter::Writes(name));
}

TEST_CASE("Serialise: twice the same text, and nothing in the record changes")
{
    const auto customer = New<CustomerDef>();
    customer->PersonalName()->Title(Text(30000, u'&'));
    const Text first = customer->Serialise();
    CHECK(customer->Serialise() == first);
    CHECK(first.size() > 150000);
}

TEST_CASE(
    "XmlWriter: what is Escaped is written with entities, also where the first room ends; the empty text is not set")
{
    CHECK(TextOf([](XmlWriter& xml) { xml.Always("A", Escaped(u"a&<>'\"&amp;")); })
          == u"\t<A>a&amp;&lt;&gt;&apos;&quot;&amp;amp;</A>\r\n");
    CHECK(TextOf([](XmlWriter& xml) { xml.IfSet("A", Escaped(u"")); }) == u"");
    CHECK(TextOf([](XmlWriter& xml) { xml.Line("<A b='", Escaped(u"'"), "'/>"); }) == u"\t<A b='&apos;'/>\r\n");
    const Text quotes(XmlWriter::kUsualRoom / 6, u'"');
    CHECK(TextOf([&](XmlWriter& xml) { xml.Always("A", Escaped(quotes)); })
          == u"\t<A>" + EscapeXML(quotes) + u"</A>\r\n");
}

TEST_CASE("XmlWriter: a list is whole, whether its items grow, shrink or stay as they are")
{
    const auto isWhole = [](std::size_t count, const std::function<std::size_t(std::size_t)>& lengthAt) {
        std::vector<Ref<ClaimHeaderDef>> items;
        Text expected;
        for (std::size_t i = 0; i < count; ++i) {
            items.push_back(New<ClaimHeaderDef>());
            items.back()->VehicleID(Text(lengthAt(i), u'x'));
            expected += items.back()->Serialise();
        }
        return TextOf([&](XmlWriter& xml) { xml.AppendEach(items); }) == expected;
    };
    CHECK(isWhole(0, [](std::size_t) { return 0; }));
    CHECK(isWhole(2000, [](std::size_t) { return 40; }));
    CHECK(isWhole(2000, [](std::size_t i) { return i; }));
    CHECK(isWhole(2000, [](std::size_t i) { return 2000 - i; }));
    CHECK(isWhole(3, [](std::size_t) { return XmlWriter::kUsualRoom; }));
}
