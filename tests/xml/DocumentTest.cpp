// Reading a document: nodes, names, texts, attributes and paths.
#include "Documents.h"

#include <utility>

namespace varnex3::xml {
namespace {

const std::u16string_view quote = u"<Xalo_Quote>\r\n"
                                  u"\t<Source Kind=\"repairer\">\r\n"
                                  u"\t\t<Name>Smith &amp; Sons</Name>\r\n"
                                  u"\t</Source>\r\n"
                                  u"\t<Item><No>1</No></Item>\r\n"
                                  u"\t<Item/>\r\n"
                                  u"\t<Item><No>3</No><No>4</No></Item>\r\n"
                                  u"</Xalo_Quote>\r\n";

std::u16string TextsOf(const NodeList& nodes)
{
    std::u16string texts;
    for (const Node& node : nodes)
        texts += node.Text() + u";";
    return texts;
}

} // namespace

TEST_CASE("A new document is empty and has the error of an empty text")
{
    const Document document;
    CHECK_FALSE(document.Root());
    CHECK_FALSE(document.DocumentElement());
    CHECK(document.Xml() == u"");
    CHECK(document.Error().code == ErrorCode::NoRootElement);
    CHECK(document.Error().line == 1);
    CHECK(document.Error().column == 1);
}

TEST_CASE("A document that is not well-formed is empty")
{
    Document document = Loaded(u"<a/>");
    CHECK_FALSE(document.LoadText(u"<a>"));
    CHECK_FALSE(document.Root());
    CHECK(document.Select("a").empty());
    CHECK(document.Xml() == u"");
}

TEST_CASE("Loading again replaces what was there, error included")
{
    Document document;
    CHECK_FALSE(document.LoadText(u"<a>"));
    CHECK(document.LoadText(u"<b/>"));
    CHECK_FALSE(document.Error());
    CHECK(document.Error().reason == u"");
    CHECK(document.DocumentElement().Name() == u"b");
}

TEST_CASE("A document can be moved; what is left behind is empty")
{
    Document first = Loaded(u"<a>x</a>");
    Document second = std::move(first);
    CHECK(second.Root().Text() == u"x");
    first = Document();
    CHECK_FALSE(first.Root());
    first = std::move(second);
    CHECK(first.Root().Text() == u"x");
}

TEST_CASE("Text and bytes give the same document")
{
    const Document fromText = Loaded(quote);
    const Document fromBytes = LoadedBytes(ToUtf8(quote));
    CHECK(fromBytes.Xml() == fromText.Xml());
    CHECK(fromBytes.SelectSingle("Xalo_Quote/Source/Name").Text() == u"Smith & Sons");
    CHECK(fromText.SelectSingle("Xalo_Quote/Source/Name").Text() == u"Smith & Sons");
}

TEST_CASE("An absent node has no name, text, markup, children or attributes")
{
    const Node absent;
    CHECK_FALSE(absent);
    CHECK(absent.Type() == NodeType::None);
    CHECK(absent.Name() == u"");
    CHECK(absent.Text() == u"");
    CHECK(absent.Xml() == u"");
    CHECK_FALSE(absent.IsElement("a"));
    CHECK_FALSE(absent.FirstChild());
    CHECK_FALSE(absent.NextSibling());
    CHECK_FALSE(ChildElements(absent).First("a"));
    CHECK(absent.AttributeCount() == 0);
    CHECK_FALSE(absent.SelectSingle("a"));
    CHECK(absent.Select("a").empty());
    CHECK(absent.ElementsByTagName("a").empty());
}

TEST_CASE("Each kind of node has its type, name and content")
{
    const Document document = Loaded(u"<r>x<!-- c --><![CDATA[<d>]]><?go now ?></r>");
    const Node root = document.DocumentElement();
    const Node text = root.FirstChild();
    const Node comment = text.NextSibling();
    const Node section = comment.NextSibling();
    const Node instruction = section.NextSibling();

    CHECK(document.Root().Type() == NodeType::Document);
    CHECK(document.Root().Name() == u"#document");
    CHECK(root.Type() == NodeType::Element);
    CHECK(root.Name() == u"r");
    CHECK(text.Type() == NodeType::Text);
    CHECK(text.Name() == u"#text");
    CHECK(text.Text() == u"x");
    CHECK(comment.Type() == NodeType::Comment);
    CHECK(comment.Name() == u"#comment");
    CHECK(comment.Text() == u" c ");
    CHECK(section.Type() == NodeType::CData);
    CHECK(section.Name() == u"#cdata-section");
    CHECK(section.Text() == u"<d>");
    CHECK(instruction.Type() == NodeType::Instruction);
    CHECK(instruction.Name() == u"go");
    CHECK(instruction.Text() == u"now ");
    CHECK_FALSE(instruction.NextSibling());
}

TEST_CASE("An element's only text is its child as any other text is")
{
    const Document document = Loaded(u"<a><b>x &lt; y</b></a>");
    const Node text = document.SelectSingle("a/b").FirstChild();
    CHECK(text.Type() == NodeType::Text);
    CHECK(text.Name() == u"#text");
    CHECK(text.Text() == u"x < y");
    CHECK(text.Xml() == u"x &lt; y");
    CHECK(text.AttributeCount() == 0);
    CHECK_FALSE(text.IsElement("b"));
    CHECK_FALSE(text.FirstChild());
    CHECK_FALSE(text.NextSibling());
    CHECK(text.ElementsByTagName("b").empty());
}

TEST_CASE("The document element is found behind comments and instructions")
{
    CHECK(Loaded(u"<!--c--><?p?><r/><!--d-->").DocumentElement().Name() == u"r");
    CHECK(Loaded(u"<!--c--><r/>").Root().FirstChild().Type() == NodeType::Comment);
}

TEST_CASE("The typed value is all text inside, without comments and instructions, nothing trimmed")
{
    CHECK(TextOf(u"<a> x<b>y <!--no--></b><?no no?><![CDATA[ z&amp;]]>!\n</a>") == u" xy  z&amp;!\n");
    CHECK(TextOf(u"<a/>") == u"");
    CHECK(TextOf(u"<a></a>") == u"");
    CHECK(Loaded(u"<a><b>1</b><c>2</c></a>").SelectSingle("a/c").Text() == u"2");
}

TEST_CASE("References stand for their characters")
{
    CHECK(TextOf(u"<a>&lt;&gt;&amp;&quot;&apos;</a>") == u"<>&\"'");
    CHECK(TextOf(u"<a>&#65;&#x42;&#x1F600;&#128512;&#0000000067;</a>") == u"AB\U0001F600\U0001F600C");
    CHECK(LoadedBytes("<a>&#xe9;&#x20AC;&#x1F600;</a>").Root().Text() == u"\u00E9\u20AC\U0001F600");
    CHECK(TextOf(u"<a>&amp;lt;</a>") == u"&lt;");
}

TEST_CASE("Line ends become LF; a carriage return by reference stays")
{
    CHECK(TextOf(u"<a>1\r\n2\r3\n4\r\r\n5</a>") == u"1\n2\n3\n4\n\n5");
    CHECK(TextOf(u"<a>&#13;\r\n</a>") == u"\r\n");
    CHECK(TextOf(u"<a><![CDATA[1\r\n2\r]]></a>") == u"1\n2\n");
    CHECK(Loaded(u"<a><!--1\r\n2--></a>").DocumentElement().FirstChild().Text() == u"1\n2");
}

TEST_CASE("White space alone between two tags is dropped")
{
    CHECK_FALSE(Loaded(u"<a> \t\r\n</a>").DocumentElement().FirstChild());
    CHECK(Loaded(u"<a> <b/> </a>").DocumentElement().FirstChild().Name() == u"b");
    CHECK_FALSE(Loaded(u"<a> <b/> </a>").SelectSingle("a/b").NextSibling());
    CHECK(TextOf(u"<a>x<!--c--> <b/> y</a>") == u"x y");
}

TEST_CASE("White space from references and CDATA sections is kept")
{
    CHECK(TextOf(u"<a>&#32;</a>") == u" ");
    CHECK(TextOf(u"<a> &#9; </a>") == u" \t ");
    CHECK(TextOf(u"<a> <![CDATA[ ]]> </a>") == u" ");
}

TEST_CASE("White space is kept where xml:space says so, down to where it says otherwise")
{
    CHECK(TextOf(u"<a xml:space=\"preserve\"> <b> </b> </a>") == u"   ");
    CHECK(TextOf(u"<a xml:space=\"preserve\"> <b xml:space='default'> <c/> </b> </a>") == u"  ");
    CHECK(TextOf(u"<a> <b xml:space='preserve'> </b> </a>") == u" ");
    CHECK(TextOf(u"<a xml:space='preserve'><b xml:space='other'> </b></a>") == u" ");
    CHECK(TextOf(u"<a xml:space='pre&#115;erve'>\r\n</a>") == u"\n");
}

TEST_CASE("Attributes are there in the order written, values resolved and their white space made blanks")
{
    const Document document = Loaded(u"<a z='1' y = \"&lt;&#10;'\"\r\n\tx='\t2\r\n3\n'/>");
    const Node element = document.DocumentElement();
    REQUIRE(element.AttributeCount() == 3);
    CHECK(element.AttributeAt(0).name == u"z");
    CHECK(element.AttributeAt(0).value == u"1");
    CHECK(element.AttributeAt(1).name == u"y");
    CHECK(element.AttributeAt(1).value == u"<\n'");
    CHECK(element.AttributeAt(2).name == u"x");
    CHECK(element.AttributeAt(2).value == u" 2 3 ");
}

TEST_CASE("Namespace declarations are not counted as attributes")
{
    const Document document = Loaded(u"<a xmlns='u' one='1' xmlns:p='v' p:two='2' xmlnsx='3'/>");
    const Node element = document.DocumentElement();
    REQUIRE(element.AttributeCount() == 3);
    CHECK(element.AttributeAt(0).name == u"one");
    CHECK(element.AttributeAt(1).name == u"p:two");
    CHECK(element.AttributeAt(2).name == u"xmlnsx");
    CHECK(Loaded(u"<a xmlns='u'/>").DocumentElement().AttributeCount() == 0);
}

TEST_CASE("Names are compared as written, prefix and letter case included")
{
    const Document document = Loaded(u"<p:a xmlns:p='u' xmlns:q='u'><q:b/><B/></p:a>");
    CHECK(document.SelectSingle("p:a/q:b"));
    CHECK_FALSE(document.SelectSingle("a"));
    CHECK_FALSE(document.SelectSingle("p:a/p:b"));
    CHECK_FALSE(document.SelectSingle("p:a/b"));
}

TEST_CASE("Names beyond ASCII are names like others")
{
    const std::u16string text = u"<Gr\u00F6\u00DFe \u4E2D='1'><\U00010400>x</\U00010400></Gr\u00F6\u00DFe>";
    for (const Document& document : {Loaded(text), LoadedBytes(ToUtf8(text))}) {
        CHECK(document
                  .SelectSingle("Gr\xC3\xB6\xC3\x9F"
                                "e/\xF0\x90\x90\x80")
                  .Text()
              == u"x");
        CHECK(document.DocumentElement().IsElement("Gr\xC3\xB6\xC3\x9F"
                                                   "e"));
        CHECK_FALSE(document.DocumentElement().IsElement("Gr\xC3\xB6\xC3\x9F"));
        CHECK_FALSE(document.DocumentElement().IsElement("Groesse"));
        CHECK(document.DocumentElement().AttributeAt(0).name == u"\u4E2D");
    }
}

TEST_CASE("IsElement wants the whole name, of an element")
{
    const Document document = Loaded(u"<Name><?Item?></Name>");
    CHECK(document.DocumentElement().IsElement("Name"));
    CHECK_FALSE(document.DocumentElement().IsElement("Nam"));
    CHECK_FALSE(document.DocumentElement().IsElement("Names"));
    CHECK_FALSE(document.DocumentElement().IsElement(""));
    CHECK_FALSE(document.DocumentElement().FirstChild().IsElement("Item"));
    CHECK_FALSE(document.Root().IsElement("#document"));
}

TEST_CASE("The first child of a name is found past other nodes, whatever comes behind it")
{
    const Document document = Loaded(u"<r>t<a>1</a><!--c--><?c d?><b/><a>2</a></r>");
    const ChildElements children(document.DocumentElement());
    CHECK(children.First("a").Text() == u"1");
    CHECK(children.First("b"));
    CHECK_FALSE(children.First("c"));
    CHECK_FALSE(children.First("t"));
    CHECK(ChildElements(document.Root()).First("r"));
}

TEST_CASE("Children are those of the node alone, not what stands inside or behind them")
{
    const Document document = Loaded(u"<r><x><a>deep</a></x><y>text</y><z/><a>1</a></r>");
    CHECK(ChildElements(document.DocumentElement()).First("a").Text() == u"1");
    for (const char* path : {"r/y", "r/z"})
        CHECK_FALSE(ChildElements(document.SelectSingle(path)).First("a"));
    CHECK_FALSE(ChildElements(document.SelectSingle("r/y").FirstChild()).First("a"));
}

TEST_CASE("A child is found although another name before it has the same bit")
{
    REQUIRE(NameBit(std::string_view("a_c")) == NameBit(std::string_view("abc")));
    const Document document = Loaded(u"<r><a_c>1</a_c><abc>2</abc><a_c>3</a_c></r>");
    const ChildElements children(document.DocumentElement());
    CHECK(children.First("a_c").Text() == u"1");
    CHECK(children.First("abc").Text() == u"2");
    CHECK_FALSE(children.First("a.c"));
}

TEST_CASE("Names are compared to the letter, whatever their length and their characters")
{
    const Document document =
        Loaded(u"<r><abc/><abcd/><abcdefg/><abcdefgh/><abcdefghijklmnopq/><ÃabcdefgÃ/><Ārchive/></r>");
    const Node r = document.DocumentElement();
    for (const char* name : {"abc", "abcd", "abcdefg", "abcdefgh", "abcdefghijklmnopq", "ÃabcdefgÃ", "Ārchive"})
        CHECK(r.SelectSingle(name));
    for (const char* name :
         {"ab", "Abc", "abC", "Abcd", "abcD", "abXdefg", "abcdefG", "Abcdefgh", "abcdefgX", "abcdefghijklmnopX",
          "abcdefghXjklmnopq", "abcdefghijklmnop", "\303abcdefg\303", "?rchive"})
        CHECK_FALSE(r.SelectSingle(name));
}

TEST_CASE("A text may be seen where it stands; one with references, or of several pieces, in the room given")
{
    const Document document = Loaded(u"<r><a>plain</a><b>&lt;</b><c>x<!--y-->z</c><d/></r>");
    std::u16string room = u"before";
    CHECK(document.SelectSingle("r/a").Text(room) == u"plain");
    CHECK(room == u"before");
    CHECK(document.SelectSingle("r/b").Text(room) == u"<");
    CHECK(document.SelectSingle("r/c").Text(room) == u"xz");
    CHECK(document.SelectSingle("r/d").Text(room) == u"");
    CHECK(Node().Text(room) == u"");
}

TEST_CASE("A path leads from the document through the root element")
{
    const Document document = Loaded(quote);
    CHECK(document.SelectSingle("Xalo_Quote/Source/Name").Text() == u"Smith & Sons");
    CHECK(document.SelectSingle("Xalo_Quote").Name() == u"Xalo_Quote");
    CHECK_FALSE(document.SelectSingle("Source/Name"));
    CHECK_FALSE(document.SelectSingle("Xalo_Quote/Name"));
    CHECK_FALSE(document.SelectSingle("Xalo_Quote/Source/Name/X"));
}

TEST_CASE("A path from an element starts with its children")
{
    const Document document = Loaded(quote);
    CHECK(document.DocumentElement().SelectSingle("Source/Name").Text() == u"Smith & Sons");
    CHECK(document.DocumentElement().Select("Item").size() == 3);
    CHECK_FALSE(document.DocumentElement().SelectSingle("Xalo_Quote"));
}

TEST_CASE("The single node of a path is the first there is, behind branches that end too early")
{
    const Document document = Loaded(u"<r><a/><a><b/></a><a><b><c>1</c></b></a><a><b><c>2</c></b></a></r>");
    CHECK(document.SelectSingle("r/a/b/c").Text() == u"1");
    CHECK_FALSE(document.SelectSingle("r/a/b/d"));
    CHECK(TextsOf(document.Select("r/a/b/c")) == u"1;2;");
}

TEST_CASE("All nodes of a path come in document order")
{
    CHECK(TextsOf(Loaded(quote).Select("Xalo_Quote/Item/No")) == u"1;3;4;");
    CHECK(TextsOf(Loaded(quote).Select("Xalo_Quote/Item")) == u"1;;34;");
    CHECK(Loaded(quote).Select("Xalo_Quote/None").empty());
}

TEST_CASE("Blanks around a step are ignored; an empty step leads nowhere")
{
    const Document document = Loaded(u"<a><b>x</b></a>");
    CHECK(document.SelectSingle(" a / b ").Text() == u"x");
    CHECK_FALSE(document.SelectSingle(""));
    CHECK_FALSE(document.SelectSingle("/"));
    CHECK_FALSE(document.SelectSingle("/a"));
    CHECK_FALSE(document.SelectSingle("a/"));
    CHECK_FALSE(document.SelectSingle("a//b"));
    CHECK_FALSE(document.SelectSingle("a b"));
}

TEST_CASE("A tag name is found at any depth, in document order, not in the node itself")
{
    const Document document = Loaded(u"<f>0<f>1<f>2</f></f><g><f>3</f></g></f>");
    CHECK(TextsOf(document.ElementsByTagName("f")) == u"0123;12;2;3;");
    CHECK(TextsOf(document.DocumentElement().ElementsByTagName("f")) == u"12;2;3;");
    CHECK(document.ElementsByTagName("h").empty());
    CHECK(document.ElementsByTagName("").empty());
}

TEST_CASE("A tag name with a parent finds the children of such parents, at any depth")
{
    const Document document =
        Loaded(u"<r><Fields><Field>1</Field></Fields><x><Fields><Field>2</Field><y><Field>no</Field>"
               u"</y></Fields></x><Field>no</Field></r>");
    CHECK(TextsOf(document.ElementsByTagName("Fields/Field")) == u"1;2;");
    CHECK(TextsOf(document.ElementsByTagName(" Fields / Field ")) == u"1;2;");
    CHECK(TextsOf(document.ElementsByTagName("x/Fields/Field")) == u"2;");
    CHECK(document.ElementsByTagName("r/Fields/x").empty());
    CHECK(document.ElementsByTagName("/Field").empty());
}

TEST_CASE("The node a tag name is looked for in counts as a parent, those above it do not")
{
    const Document document = Loaded(u"<a><b><c>1</c></b></a>");
    const Node b = document.SelectSingle("a/b");
    CHECK(TextsOf(b.ElementsByTagName("b/c")) == u"1;");
    CHECK(b.ElementsByTagName("a/b/c").empty());
}

TEST_CASE("A DOCTYPE without declarations is passed over")
{
    CHECK(TextOf(u"<!DOCTYPE a><a>x</a>") == u"x");
    CHECK(TextOf(u"<?xml version='1.0'?> <!--c--> <!DOCTYPE a SYSTEM 'nowhere.dtd' > <a>x</a>") == u"x");
    CHECK(TextOf(u"<!DOCTYPE p:a PUBLIC \"-//X//Y\" 'http://nowhere/'><a>x</a>") == u"x");
    CHECK(Loaded(u"<!DOCTYPE a><a/>").Root().FirstChild().Name() == u"a");
}

TEST_CASE("A declaration may name any version 1")
{
    for (const char16_t* declaration : {u"<?xml version=\"1.0\"?>", u"<?xml version='1.1' ?>",
                                        u"<?xml\tversion = '1.10'?>", u"<?xml version='1.0' standalone='no'?>"})
        CHECK(TextOf(std::u16string(declaration) + u"<a>x</a>") == u"x");
}

TEST_CASE("A text's declared encoding is not looked at, a mark before it is skipped")
{
    CHECK(TextOf(u"<?xml version='1.0' encoding='klingon'?><a>\u20AC</a>") == u"\u20AC");
    CHECK(TextOf(u"\uFEFF<?xml version='1.0' encoding='utf-16'?><a>x</a>") == u"x");
}

TEST_CASE("An instruction may be named like a declaration, and have any content")
{
    const Document document = Loaded(u"<?xml-stylesheet href='a'?><r><?p?><?q  a<b &?></r>");
    CHECK(document.Root().FirstChild().Name() == u"xml-stylesheet");
    CHECK(document.DocumentElement().FirstChild().Text() == u"");
    CHECK(document.DocumentElement().FirstChild().NextSibling().Text() == u"a<b &");
}

TEST_CASE("A prefix may be declared on the element that uses it, and again further in")
{
    CHECK(Loaded(u"<p:a xmlns:p='u'><p:b xmlns:p='v' p:c=''/></p:a>").DocumentElement());
    CHECK(Loaded(u"<a xmlns='u'><b xmlns=''/></a>").DocumentElement());
    CHECK(Loaded(u"<a xml:lang='en' xmlns:xml='http://www.w3.org/XML/1998/namespace'/>").DocumentElement());
    CHECK(Loaded(u"<a xmlns:p='u' xmlns:q='v' p:b='' q:b='' b=''/>").DocumentElement().AttributeCount() == 3);
    CHECK(Loaded(u"<a xmlns='u' xmlns:p='u' p:b='' b=''/>").DocumentElement().AttributeCount() == 2);
}

} // namespace varnex3::xml
