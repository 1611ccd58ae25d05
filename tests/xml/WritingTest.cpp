// Writing markup: what is written loads to the same tree, and is written the same again.
#include "Documents.h"

#include <utility>
#include <vector>

namespace varnex3::xml {
namespace {

// Every node in document order with its depth, type, name, content and attributes: what two equal trees have alike.
std::u16string Outline(const Node& top)
{
    std::u16string outline;
    std::vector<std::pair<Node, std::u16string>> open{{top, u""}};
    while (!open.empty()) {
        const auto [node, indent] = open.back();
        open.pop_back();
        outline += indent + static_cast<char16_t>(u'0' + static_cast<int>(node.Type())) + node.Name();
        for (std::size_t i = 0; i < node.AttributeCount(); ++i)
            outline += u" " + node.AttributeAt(i).name + u"=" + node.AttributeAt(i).value;
        if (node.Type() > NodeType::Element)
            outline += u":" + node.Text();
        outline += u"\n";
        if (const Node next = node.NextSibling(); next && !indent.empty())
            open.emplace_back(next, indent);
        if (const Node child = node.FirstChild())
            open.emplace_back(child, indent + u".");
    }
    return outline;
}

std::u16string XmlOf(std::u16string_view text) { return Loaded(text).Xml(); }

// The markup of the first element of a name.
std::u16string FragmentOf(std::u16string_view text, std::string_view name)
{
    const Document document = Loaded(text);
    const NodeList found = document.ElementsByTagName(name);
    REQUIRE_FALSE(found.empty());
    return found[0].Xml();
}

const std::u16string_view odd[] = {
    u"<a/>",
    u"<a></a>",
    u"<a>x</a>",
    u"<a> x </a>",
    u"<a>&#32;</a>",
    u"<a>&#9;&#10;&#13;</a>",
    u"<a> &#32; </a>",
    u"<a>\r\n</a>",
    u"<a>x\r\ny\rz\nw</a>",
    u"<a>x&#13;&#10;y</a>",
    u"<a>&lt;&gt;&amp;&quot;&apos; > \" ' ]] ]&gt; ]]&gt;</a>",
    u"<a><![CDATA[]]></a>",
    u"<a><![CDATA[ ]]></a>",
    u"<a><![CDATA[<&]]]]><![CDATA[>]]></a>",
    u"<a>x<![CDATA[y]]>z</a>",
    u"<a><!----></a>",
    u"<a><!-- x\r\n\ty --></a>",
    u"<a>x<!--y-->z</a>",
    u"<a><?p?><?q  r?></a>",
    u"<a b='1' c=\"2\"/>",
    u"<a b='\"' c=\"'\"/>",
    u"<a b='&#9;&#10;&#13;&#32; &lt;&amp;&apos;&quot;'/>",
    u"<a b='\t\r\n '></a>",
    u"<a\r\n\tb = '1'\r\n\tc='2'\r\n/>",
    u"<a><b/><c></c><d>x</d></a>",
    u"<a><b><c><d/></c></b></a>",
    u"<a>x<b><c/><d/></b></a>",
    u"<a><b>x<c/></b><d/></a>",
    u"<a><b/>x</a>",
    u"<a xml:space='preserve'><b/> <c> </c>\r\n</a>",
    u"<a xml:space='preserve'> <b xml:space='default'> <c/> <d/> </b> </a>",
    u"<a><b xml:space='preserve'><c/><d/></b><e><f/></e></a>",
    u"<a xml:space='default'><b xml:space='preserve'>\t</b></a>",
    u"<!--before--><?p q?><a/><!--after-->",
    u"<?xml version='1.0'?><a/>",
    u"<?xml version='1.0' encoding='utf-8' standalone='yes'?><a/>",
    u"<?xml version='1.1' standalone='no'?><!--c--><a/>",
    u"<p:a xmlns:p='u' p:b=''><p:c xmlns:p='v'/></p:a>",
    u"<a xmlns='u'><b xmlns=''><c xmlns='w'/></b></a>",
    u"<Gr\u00F6\u00DFe w=\"\u20AC\U0001F600\">\u4E2D\U0001F600\u0085\u2028</Gr\u00F6\u00DFe>",
    u"<a>x<b><c/>\n<d>\n<e/></d></b></a>",
    u"<a><b><!--c--></b><b><?p?></b></a>",
};

} // namespace

TEST_CASE("What is written loads to the same tree and is written the same again")
{
    for (const std::u16string_view text : odd) {
        const Document first = Loaded(text);
        const std::u16string written = first.Xml();
        const Document second = Loaded(written);
        CAPTURE(Shown(written));
        CHECK(Outline(second.Root()) == Outline(first.Root()));
        CHECK(second.Xml() == written);
    }
}

TEST_CASE("The same from UTF-8")
{
    for (const std::u16string_view text : odd) {
        const Document document = LoadedBytes(ToUtf8(text));
        CHECK(document.Xml() == XmlOf(text));
        CHECK(Outline(document.Root()) == Outline(Loaded(text).Root()));
    }
}

TEST_CASE("Every node inside is written so that it loads to the same node")
{
    for (const std::u16string_view text : odd) {
        const Document document = Loaded(text);
        for (const Node& node : document.ElementsByTagName("b")) {
            const std::u16string written = node.Xml();
            const Document second = Loaded(written);
            CAPTURE(Shown(written));
            CHECK(Outline(second.DocumentElement()) == Outline(node));
            CHECK(second.DocumentElement().Xml() == written);
        }
    }
}

TEST_CASE("A message in the usual layout is reproduced to the byte")
{
    const std::u16string_view message = u"<?xml version=\"1.0\"?>\r\n"
                                        u"<Xalo_Quote>\r\n"
                                        u"\t<Version>\r\n"
                                        u"\t\t<XaloVersion>1.6</XaloVersion>\r\n"
                                        u"\t</Version>\r\n"
                                        u"\t<OtherParty/>\r\n"
                                        u"\t<Notes>it&apos;s &quot;so&quot; &amp; &lt;so&gt;</Notes>\r\n"
                                        u"\t<Field name=\"a\"></Field>\r\n"
                                        u"</Xalo_Quote>\r\n";
    CHECK(XmlOf(message) == message);
    CHECK(LoadedBytes(ToUtf8(message)).Xml() == message);
}

TEST_CASE("Elements that hold only elements are laid out one to a line")
{
    CHECK(XmlOf(u"<a><b>x</b><!--c--><?p?><d><e/></d></a>")
          == u"<a>\r\n\t<b>x</b>\r\n\t<!--c-->\r\n\t<?p?>\r\n\t<d>\r\n\t\t<e/>\r\n\t</d>\r\n</a>\r\n");
}

TEST_CASE("Nothing is laid out beside text, nor further in")
{
    CHECK(XmlOf(u"<a>x<b><c/><d/></b></a>") == u"<a>x<b><c/><d/></b></a>\r\n");
    CHECK(XmlOf(u"<a><b>x<c><d/></c></b><e><f/></e></a>")
          == u"<a>\r\n\t<b>x<c><d/></c></b>\r\n\t<e>\r\n\t\t<f/>\r\n\t</e>\r\n</a>\r\n");
    CHECK(XmlOf(u"<a><![CDATA[x]]><b/></a>") == u"<a><![CDATA[x]]><b/></a>\r\n");
}

TEST_CASE("Nothing is laid out where white space is preserved")
{
    CHECK(XmlOf(u"<a><b xml:space='preserve'><c/> <d/></b><e/></a>")
          == u"<a>\r\n\t<b xml:space='preserve'><c/> <d/></b>\r\n\t<e/>\r\n</a>\r\n");
}

TEST_CASE("White space that would be lost in a part of a document is written as references")
{
    const std::u16string_view text = u"<a xml:space='preserve'><b> <c>\t\r\n</c>x</b></a>";
    CHECK(FragmentOf(text, "b") == u"<b>&#32;<c>&#9;&#10;</c>x</b>");
    CHECK(XmlOf(text) == u"<a xml:space='preserve'><b> <c>\t\r\n</c>x</b></a>\r\n");
    CHECK(Loaded(text).SelectSingle("a/b").FirstChild().Xml() == u"&#32;");
}

TEST_CASE("References, quotes and both kinds of empty element stay as they were written")
{
    CHECK(XmlOf(u"<a b='\"'  c=\"&#x41;\"><d/><e></e>&#65;&gt;></a>")
          == u"<a b='\"' c=\"&#x41;\"><d/><e></e>&#65;&gt;></a>\r\n");
}

TEST_CASE("An element of white space alone is written empty") { CHECK(XmlOf(u"<a> </a>") == u"<a></a>\r\n"); }

TEST_CASE("The declaration is written without encoding, standalone kept")
{
    CHECK(XmlOf(u"<?xml version='1.1' encoding='utf-8'?><a/>") == u"<?xml version=\"1.0\"?>\r\n<a/>\r\n");
    CHECK(XmlOf(u"<?xml version='1.0' standalone='yes'?><a/>")
          == u"<?xml version=\"1.0\" standalone=\"yes\"?>\r\n<a/>\r\n");
    CHECK(XmlOf(u"<?xml version='1.0' standalone='no'?><a/>")
          == u"<?xml version=\"1.0\" standalone=\"no\"?>\r\n<a/>\r\n");
    CHECK(XmlOf(u"<a/>") == u"<a/>\r\n");
}

TEST_CASE("The document node is written like the document, other nodes without a line end")
{
    const Document document = Loaded(u"<?xml version='1.0'?><!--c--><a>x<b/><?p q?></a>");
    CHECK(document.Root().Xml() == document.Xml());
    CHECK(document.Root().FirstChild().Xml() == u"<!--c-->");
    CHECK(document.DocumentElement().Xml() == u"<a>x<b/><?p q?></a>");
    CHECK(document.SelectSingle("a/b").Xml() == u"<b/>");
    CHECK(document.SelectSingle("a/b").NextSibling().Xml() == u"<?p q?>");
}

TEST_CASE("A part of a document is laid out from the left margin")
{
    CHECK(FragmentOf(u"<a><b><c><d>x</d></c></b></a>", "c") == u"<c>\r\n\t<d>x</d>\r\n</c>");
}

TEST_CASE("A part declares the prefixes it uses that are declared further up")
{
    const std::u16string_view text = u"<a xmlns:p='u' xmlns:q=\"v\" xmlns:r='w'><b c='1'><p:d q:e=''/></b></a>";
    CHECK(FragmentOf(text, "b") == u"<b c='1' xmlns:p='u' xmlns:q=\"v\">\r\n\t<p:d q:e=''/>\r\n</b>");
}

TEST_CASE("A part declares the default namespace it is in, unless it declares its own")
{
    CHECK(FragmentOf(u"<a xmlns='u'><b/></a>", "b") == u"<b xmlns='u'/>");
    CHECK(FragmentOf(u"<a xmlns='u'><b xmlns='v'/></a>", "b") == u"<b xmlns='v'/>");
    CHECK(FragmentOf(u"<a xmlns='u'><c xmlns=''><b/></c></a>", "b") == u"<b/>");
    CHECK(FragmentOf(u"<p:a xmlns:p='v' xmlns='u'><p:b/></p:a>", "p:b") == u"<p:b xmlns:p='v'/>");
}

TEST_CASE("The nearest declaration counts, and one inside the part is its own")
{
    CHECK(FragmentOf(u"<a xmlns:p='u'><c xmlns:p='v'><b p:d=''/></c></a>", "b") == u"<b p:d='' xmlns:p='v'/>");
    CHECK(FragmentOf(u"<a xmlns:p='u'><b><p:c xmlns:p='v'/></b></a>", "b") == u"<b>\r\n\t<p:c xmlns:p='v'/>\r\n</b>");
    CHECK(FragmentOf(u"<a xmlns:p='u'><b><p:c xmlns:p='v'/><p:d/></b></a>", "b")
          == u"<b xmlns:p='u'>\r\n\t<p:c xmlns:p='v'/>\r\n\t<p:d/>\r\n</b>");
    CHECK(FragmentOf(u"<a xmlns:p='u'><b xml:lang='en'/></a>", "b") == u"<b xml:lang='en'/>");
}

TEST_CASE("A DOCTYPE is not written") { CHECK(XmlOf(u"<!DOCTYPE a SYSTEM 'x'><a/>") == u"<a/>\r\n"); }

} // namespace varnex3::xml
