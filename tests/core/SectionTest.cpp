#include "varnex3/core/XmlSection.h"

#include <random>

#include "tests/Printing.h"
#include "varnex3/core/CustomerDef.h"
#include "varnex3/core/modGeneral.h"

using namespace varnex3;
using tests::RaisedBy;

namespace {

xml::Document Loaded(TextView text)
{
    xml::Document document;
    document.LoadText(text);
    return document;
}

// A section that is the whole of a text.
struct TextSection
{
    xml::Document document;
    XmlSection section;
    explicit TextSection(TextView text) : document(Loaded(text)), section(document.DocumentElement(), "ReaderDef") {}
    const XmlSection* operator->() const { return &section; }
};

} // namespace

TEST_CASE("GetNodeValue: the text of the first element on the path; Empty when there is none")
{
    const xml::Document document = Loaded(u"<A><B> x </B><B>y</B><C/></A>");
    CHECK(ToText(GetNodeValue(document.Root(), u"A/B")) == u" x ");
    CHECK(std::get<Text>(GetNodeValue(document.Root(), u"A/C")) == u"");
    CHECK(IsEmpty(GetNodeValue(document.Root(), u"A/D")));
    CHECK(IsEmpty(GetNodeValue(document.Root(), u"B")));
    CHECK(IsEmpty(GetNodeValue(Loaded(u"<A").Root(), u"A")));
}

TEST_CASE("GetNodeValue: an absent element converts to the empty text, 0 and the zero date")
{
    const Variant absent = GetNodeValue(Loaded(u"<A/>").Root(), u"A/B");
    CHECK(ToText(absent) == u"");
    CHECK(ToDouble(absent) == 0);
    CHECK(ToInt32(absent) == 0);
    CHECK(ToDate(absent) == Date{});
    CHECK_FALSE(ToBoolean(absent));
}

TEST_CASE("GetNodeXML: start tag, content and end tag of the first element; the empty text when there is none")
{
    const xml::Document document = Loaded(u"<A><B a=\"1\">x &amp; y</B><B/></A>");
    CHECK(std::get<Text>(GetNodeXML(document.Root(), u"A/B")) == u"<B a=\"1\">x &amp; y</B>");
    CHECK(std::get<Text>(GetNodeXML(document.Root(), u"A/C")) == u"");
}

TEST_CASE("TextAt: absent gives the empty text; RequiredTextAt raises on behalf of the reader")
{
    const TextSection a(u"<A><B>x</B></A>");
    CHECK(a->TextAt("A/B") == u"x");
    CHECK(a->TextAt("A/C") == u"");
    CHECK(a->TextAt("X/B") == u"");
    CHECK(a->RequiredTextAt("A/B") == u"x");
    CHECK(RaisedBy([&] { a->RequiredTextAt("A/C"); }) == "91 ReaderDef.ParseXML");
}

TEST_CASE("NumberAt and Int32At: absent gives 0; what is no number raises, the element named")
{
    const TextSection a(u"<A><B>1.5</B><C>x</C><D/></A>");
    CHECK(a->NumberAt("A/B") == 1.5);
    CHECK(a->Int32At("A/B") == 2);
    CHECK(a->NumberAt("A/X") == 0);
    CHECK(a->Int32At("A/X") == 0);
    CHECK(RaisedBy([&] { a->NumberAt("A/C"); }) == "13 ReaderDef.ParseXML");
    CHECK(RaisedBy([&] { a->NumberAt("A/D"); }) == "13 ReaderDef.ParseXML");
    try {
        a->Int32At("A/C");
    } catch (const Error& error) {
        CHECK(error.Description() == u"C: 'x' is not a number");
    }
}

TEST_CASE("ElementsNamed: at any depth, in document order, the section's own element included")
{
    CHECK(TextSection(u"<A><B>1</B><C><B>2<B>3</B></B></C></A>")->ElementsNamed("B").size() == 3);
    CHECK(TextSection(u"<B><B/></B>")->ElementsNamed("B").size() == 2);
    CHECK(TextSection(u"<A/>")->ElementsNamed("B").empty());
    CHECK(TextSection(u"no xml")->ElementsNamed("B").empty());
}

TEST_CASE("FirstAttributeOf: the first one written, namespace declarations not counted; without one an error")
{
    const TextSection a(u"<A><B xmlns:n=\"urn:n\" z=\"1\" a=\"2\"/><B xmlns=\"urn:n\"/></A>");
    const xml::NodeList found = a->ElementsNamed("B");
    CHECK(a->FirstAttributeOf(found[0]) == u"1");
    CHECK(RaisedBy([&] { a->FirstAttributeOf(found[1]); }) == "91 ReaderDef.ParseXML");
}

TEST_CASE("RequiredFirstAttributeAt: an element without an attribute and one that is missing are told apart")
{
    const TextSection a(u"<A z=\"1\" y=\"2\"><B c=\"3\"/><D/></A>");
    CHECK(a->RequiredFirstAttributeAt("A") == u"1");
    CHECK(a->RequiredFirstAttributeAt("A/B") == u"3");
    const auto description = [](const auto& read) {
        try {
            read();
        } catch (const Error& error) {
            return error.Source() + u": " + error.Description();
        }
        return Text();
    };
    CHECK(description([&] { a->RequiredFirstAttributeAt("A/D"); })
          == u"ReaderDef.ParseXML: the element D has no attribute");
    CHECK(description([&] { a->RequiredFirstAttributeAt("X"); }) == u"ReaderDef.ParseXML: the element X is missing");
}

TEST_CASE("A section that a child reads in place reads as its own text loaded again")
{
    // Pieces that make the difference, if there is one: white space, xml:space, prefixes, comments, CDATA, references.
    const Text pieces[] = {u"<Title>Ms</Title>",
                           u"<Forname> </Forname>",
                           u"<Surname>&#32;</Surname>",
                           u"<Surname xml:space=\"preserve\">\t</Surname>",
                           u"<Forname xml:space=\"default\"> \r\n </Forname>",
                           u"<HomePhone><![CDATA[ ]]></HomePhone>",
                           u"<Title>a<!-- b -->c<?d e?><f>g</f></Title>",
                           u"<p:Surname>x</p:Surname>",
                           u"<Title p:a=\"1\">&lt;&amp;&#xD;&#xA;</Title>",
                           u"\r\n\t ",
                           u"text &gt; ",
                           u"<!-- comment -->",
                           u"<PersonalName><Surname>deeper</Surname></PersonalName>",
                           u"<Surname>]]&gt; é€\U0001F600</Surname>"};
    std::mt19937 random(3);
    const auto pick = [&] { return pieces[random() % std::size(pieces)]; };
    for (int i = 0; i < 2000; ++i) {
        const Text space = random() % 3 == 0 ? u" xml:space=\"preserve\"" : u"";
        const Text text = u"<Customer xmlns:p=\"urn:p\"" + space + u">" + pick() + u"<PersonalName>" + pick() + pick()
                          + pick() + u"</PersonalName>" + pick() + u"</Customer>";
        CAPTURE(text);
        const xml::Document document = Loaded(text);
        REQUIRE(document.Root());

        const auto customer = New<CustomerDef>();
        customer->ParseXML(text);
        const auto again = New<PersonalNameDef>();
        again->ParseXML(ToText(GetNodeXML(document.Root(), u"Customer/PersonalName")));

        const auto name = customer->PersonalName();
        CHECK(name->Title() == again->Title());
        CHECK(name->Forname() == again->Forname());
        CHECK(name->Surname() == again->Surname());
        CHECK(name->HomePhone() == again->HomePhone());
    }
}

TEST_CASE("Int16At: a number of 16 bits; absent gives 0")
{
    const TextSection section(u"<A><B>-32768</B><C>32768</C><D/></A>");
    CHECK(section->Int16At("A/B") == -32768);
    CHECK(section->Int16At("A/X") == 0);
    CHECK(RaisedBy([&] { section->Int16At("A/C"); }) == "6 ReaderDef.ParseXML");
    CHECK(RaisedBy([&] { section->Int16At("A/D"); }) == "13 ReaderDef.ParseXML");
}

TEST_CASE("Has, NodesAt and FirstChildOf: what is there, whatever it holds")
{
    const TextSection section(u"<A><B/><C>x</C><B><!--c--><D/></B></A>");
    CHECK(section->Has("A/B"));
    CHECK_FALSE(section->Has("A/D"));
    CHECK_FALSE(section->Has("B"));
    CHECK(section->NodesAt("A/B").size() == 2);
    CHECK(section->NodesAt("X/B").empty());
    CHECK(section->FirstChildOf("A/C").Text() == u"x");
    CHECK_FALSE(static_cast<bool>(section->FirstChildOf("A/B")));
    CHECK(section->FirstChildOf("A").Name() == u"B");
}

TEST_CASE("ReadIntoWhereUsed: a child reads its section, and an absent one only when it was made")
{
    const TextSection section(u"<A><PersonalName><Surname>S</Surname></PersonalName></A>");
    Child<PersonalNameDef> used;
    CHECK(section->ReadIntoWhereUsed(used, "A/PersonalName"));
    CHECK(used->Surname() == u"S");
    CHECK_FALSE(section->ReadIntoWhereUsed(used, "A/Other"));
    CHECK(used->Surname() == u"");
    Child<PersonalNameDef> unused;
    CHECK_FALSE(section->ReadIntoWhereUsed(unused, "A/Other"));
    CHECK_FALSE(unused.IsMade());
}

TEST_CASE("Verbs find the first element of a name, whatever stands around it and in whatever order they ask")
{
    constexpr ElementPath paths[] = {"R/A", "R/B", "R/AB", "R/BA", "R/Part", "R/Prat", "R/Total", "R/Towing"};
    std::mt19937 random(1);
    const auto any = [&] { return paths[random() % std::size(paths)]; };
    int wrong = 0;
    for (int i = 0; i < 2000; ++i) {
        Text text = u"<R>";
        for (auto children = random() % 8; children > 0; --children) {
            const Text name = ToText(any().Inner());
            text += u"<" + name + u">" + Text(1, static_cast<char16_t>(u'a' + children)) + u"</" + name + u">";
        }
        const TextSection section(text + u"</R>");
        for (int j = 0; j < 12; ++j) {
            const ElementPath path = any();
            wrong += section->TextAt(path) != section.document.SelectSingle(path.Whole()).Text();
        }
    }
    CHECK(wrong == 0);
}

TEST_CASE("ElementPath: the group, what follows it, its last step; blanks around the rest do not matter")
{
    constexpr ElementPath path("Vehicle/ModelID ");
    CHECK(path.Group() == "Vehicle");
    CHECK(path.Inner() == "ModelID");
    CHECK_FALSE(path.IsDeep());
    CHECK(path.LastStep() == "ModelID");
    CHECK(path.Whole() == "Vehicle/ModelID");
    constexpr ElementPath deep("A/B/C");
    CHECK(deep.IsDeep());
    CHECK(deep.LastStep() == "C");
    CHECK(ElementPath("A").IsGroup());
    CHECK(ElementPath("A").LastStep() == "A");
    const TextSection section(u"<A><B><D/></B><B><C>x</C></B></A>");
    CHECK(section->TextAt("A/B/C") == u"x");
}
