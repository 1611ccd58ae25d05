// What is not well-formed is refused, with the kind of fault and its place.
#include "Documents.h"

#include <ostream>

namespace varnex3::xml {
namespace {

struct Case
{
    std::string_view bytes;
    ErrorCode code;
    std::uint32_t line;
    std::uint32_t column;
};

using enum ErrorCode;

// Rows are in the order of the codes.
const Case cases[] = {
    {"<", UnexpectedEnd, 1, 2},
    {"<a", UnexpectedEnd, 1, 3},
    {"<a ", UnexpectedEnd, 1, 4},
    {"<a b", UnexpectedEnd, 1, 5},
    {"<a b=", UnexpectedEnd, 1, 6},
    {"<a b='c", UnexpectedEnd, 1, 8},
    {"<a b='c'", UnexpectedEnd, 1, 9},
    {"<a/", UnexpectedEnd, 1, 4},
    {"<a>", UnexpectedEnd, 1, 4},
    {"<a>\r\n<b></b>x", UnexpectedEnd, 2, 9},
    {"<a></", UnexpectedEnd, 1, 6},
    {"<a></a", UnexpectedEnd, 1, 7},
    {"<abc></ab", UnexpectedEnd, 1, 10},
    {"<a></a ", UnexpectedEnd, 1, 8},
    {"<a>&", UnexpectedEnd, 1, 5},
    {"<a>&am", UnexpectedEnd, 1, 7},
    {"<a>&#", UnexpectedEnd, 1, 6},
    {"<a>&#x41", UnexpectedEnd, 1, 9},
    {"<a><!", UnexpectedEnd, 1, 6},
    {"<a><!-", UnexpectedEnd, 1, 7},
    {"<a><!-- x", UnexpectedEnd, 1, 10},
    {"<a><!-- x -", UnexpectedEnd, 1, 12},
    {"<a><!-- x --", UnexpectedEnd, 1, 13},
    {"<a><![CDA", UnexpectedEnd, 1, 10},
    {"<a><![CDATA[x]]</a>", UnexpectedEnd, 1, 20},
    {"<a><?", UnexpectedEnd, 1, 6},
    {"<a><?p", UnexpectedEnd, 1, 7},
    {"<a><?p x ?", UnexpectedEnd, 1, 11},
    {"<?xml version='1.0'", UnexpectedEnd, 1, 20},
    {"<!DOCTYPE", UnexpectedEnd, 1, 10},
    {"<!DOCTYPE a SYSTEM 'x", UnexpectedEnd, 1, 22},

    {"", NoRootElement, 1, 1},
    {"  \r\n ", NoRootElement, 2, 2},
    {"<!--c-->", NoRootElement, 1, 9},
    {"<?xml version='1.0'?>\n", NoRootElement, 2, 1},
    {"<!DOCTYPE a>", NoRootElement, 1, 13},

    {"x", TextOutsideRoot, 1, 1},
    {"x<a/>", TextOutsideRoot, 1, 1},
    {"\t\n x<a/>", TextOutsideRoot, 2, 2},
    {"<a/>x", TextOutsideRoot, 1, 5},
    {"<a/>\r\n&#32;", TextOutsideRoot, 2, 1},
    {"<![CDATA[x]]><a/>", TextOutsideRoot, 1, 1},
    {"<a/><![CDATA[]]>", TextOutsideRoot, 1, 5},
    {"\xC3\xA9<a/>", TextOutsideRoot, 1, 1},

    {"<a/><b/>", SecondRoot, 1, 5},
    {"<a></a>\r\r<!--c--><a>", SecondRoot, 3, 9},

    {"<a>\x01</a>", InvalidCharacter, 1, 4},
    {std::string_view("<a>\0</a>", 8), InvalidCharacter, 1, 4},
    {std::string_view("<a>x\0", 5), InvalidCharacter, 1, 5},
    {"<a>x\x1F</a>", InvalidCharacter, 1, 5},
    {"<a>\xEF\xBF\xBF</a>", InvalidCharacter, 1, 4},
    {"<a>\xEF\xBF\xBE</a>", InvalidCharacter, 1, 4},
    {"<a>\n\n&#0;</a>", InvalidCharacter, 3, 1},
    {"<a>&#8;</a>", InvalidCharacter, 1, 4},
    {"<a>&#xD800;</a>", InvalidCharacter, 1, 4},
    {"<a>&#xFFFE;</a>", InvalidCharacter, 1, 4},
    {"<a>&#x110000;</a>", InvalidCharacter, 1, 4},
    {"<a>&#99999999999999999999;</a>", InvalidCharacter, 1, 4},
    {"<a b='&#1;'/>", InvalidCharacter, 1, 7},
    {"<a b='\x02'/>", InvalidCharacter, 1, 7},
    {"<a \x01/>", InvalidCharacter, 1, 4},
    {"<a><!--\x0B--></a>", InvalidCharacter, 1, 8},
    {"<a><?p \x0C?></a>", InvalidCharacter, 1, 8},
    {"<a><![CDATA[\x0E]]></a>", InvalidCharacter, 1, 13},
    {"\x01<a/>", InvalidCharacter, 1, 1},
    {"<a/>\x7F\x01", TextOutsideRoot, 1, 5},
    {"<\x01/>", InvalidCharacter, 1, 2},
    {"<!DOCTYPE a SYSTEM '\x01'><a/>", InvalidCharacter, 1, 21},

    {"<a>\xFF</a>", InvalidSequence, 1, 4},
    {"<a>\x80</a>", InvalidSequence, 1, 4},
    {"<a>\xC3</a>", InvalidSequence, 1, 4},
    {"<a>\xC3", InvalidSequence, 1, 4},
    {"<a>\xC0\x80</a>", InvalidSequence, 1, 4},
    {"<a>\xE0\x80\xAF</a>", InvalidSequence, 1, 4},
    {"<a>\xED\xA0\x80</a>", InvalidSequence, 1, 4},
    {"<a>\xF4\x90\x80\x80</a>", InvalidSequence, 1, 4},
    {"<a>\xF0\x9F\x98</a>", InvalidSequence, 1, 4},
    {"<a>caf\xE9</a>", InvalidSequence, 1, 7},
    {"<a b='\xE9'/>", InvalidSequence, 1, 7},
    {"<\xE9/>", InvalidSequence, 1, 2},
    {"<a\xE9/>", InvalidSequence, 1, 3},
    {"<!--\xE9--><a/>", InvalidSequence, 1, 5},

    {"< a/>", InvalidName, 1, 2},
    {"<1/>", InvalidName, 1, 2},
    {"<-a/>", InvalidName, 1, 2},
    {"<a><.b/></a>", InvalidName, 1, 5},
    {"<></>", InvalidName, 1, 2},
    {"<a$/>", InvalidName, 1, 3},
    {"<a\xC3\x97/>", InvalidName, 1, 3},
    {"<a 1='x'/>", InvalidName, 1, 4},
    {"<a ='x'/>", InvalidName, 1, 4},
    {"<:/>", InvalidName, 1, 2},
    {"<:a/>", InvalidName, 1, 2},
    {"<a:/>", InvalidName, 1, 2},
    {"<a:b:c/>", InvalidName, 1, 2},
    {"<a:1/>", InvalidName, 1, 2},
    {"<a xmlns:='u'/>", InvalidName, 1, 4},
    {"<a></1>", InvalidName, 1, 6},
    {"<a></>", InvalidName, 1, 6},
    {"<!DOCTYPE 1><a/>", InvalidName, 1, 11},
    {"<!DOCTYPE a:b:c><a/>", InvalidName, 1, 11},

    {"<a></b>", TagMismatch, 1, 6},
    {"<a></A>", TagMismatch, 1, 6},
    {"<a>\r\n\t<b>\r\n\t</a>\r\n</b>", TagMismatch, 3, 4},
    {"<a>x</ab>", TagMismatch, 1, 7},
    {"<ab>x</a>", TagMismatch, 1, 8},
    {"</a>", TagMismatch, 1, 3},
    {"<a/></a>", TagMismatch, 1, 7},
    {"<p:a xmlns:p='u' xmlns:q='u'></q:a>", TagMismatch, 1, 32},

    {"<a b='1' b='2'/>", DuplicateAttribute, 1, 10},
    {"<a b='1' c='2'\nb='3'/>", DuplicateAttribute, 2, 1},
    {"<a xmlns='u' xmlns='v'/>", DuplicateAttribute, 1, 14},
    {"<a xmlns:p='u' xmlns:p='u'/>", DuplicateAttribute, 1, 16},
    {"<a xmlns:p='u' xmlns:q='u' p:b='' q:b=''/>", DuplicateAttribute, 1, 35},
    {"<a xmlns:p='u' xmlns:q='&#117;' p:b='' q:b=''/>", DuplicateAttribute, 1, 40},
    {"<a c1='' c2='' c3='' c4='' c5='' c6='' c7='' c8='' c9='' c3=''/>", DuplicateAttribute, 1, 58},

    {"<a b/>", InvalidAttribute, 1, 5},
    {"<a b c='1'/>", InvalidAttribute, 1, 6},
    {"<a b=1/>", InvalidAttribute, 1, 6},
    {"<a b='1'c='2'/>", InvalidAttribute, 1, 9},
    {"<a b='1''/>", InvalidAttribute, 1, 9},

    {"<a b='<'/>", LessThanInAttribute, 1, 7},
    {"<a b='x<y'/>", LessThanInAttribute, 1, 8},

    {"<a>a & b</a>", InvalidReference, 1, 6},
    {"<a>&</a>", InvalidReference, 1, 4},
    {"<a>&amp</a>", InvalidReference, 1, 4},
    {"<a>& amp;</a>", InvalidReference, 1, 4},
    {"<a>&amp ;</a>", InvalidReference, 1, 4},
    {"<a>&;</a>", InvalidReference, 1, 4},
    {"<a>&1;</a>", InvalidReference, 1, 4},
    {"<a>&#;</a>", InvalidReference, 1, 4},
    {"<a>&#x;</a>", InvalidReference, 1, 4},
    {"<a>&#xG;</a>", InvalidReference, 1, 4},
    {"<a>&#X41;</a>", InvalidReference, 1, 4},
    {"<a>&#4A;</a>", InvalidReference, 1, 4},
    {"<a b='&'/>", InvalidReference, 1, 7},
    {"<a b='x&y=1'/>", InvalidReference, 1, 8},

    {"<a>&nbsp;</a>", UndefinedEntity, 1, 4},
    {"<a>&AMP;</a>", UndefinedEntity, 1, 4},
    {"<a b='&eacute;'/>", UndefinedEntity, 1, 7},
    {"<!DOCTYPE a SYSTEM 'x'><a>&b;</a>", UndefinedEntity, 1, 27},

    {"<a>]]></a>", CDataEndInText, 1, 4},
    {"<a>x]]]></a>", CDataEndInText, 1, 6},
    {"<a><b/>]]></a>", CDataEndInText, 1, 8},

    {"<a><!-- x -- y --></a>", InvalidComment, 1, 13},
    {"<a><!-- x ---></a>", InvalidComment, 1, 13},
    {"<!----->", InvalidComment, 1, 7},

    {" <?xml version='1.0'?><a/>", InvalidInstruction, 1, 4},
    {"<a><?xml version='1.0'?></a>", InvalidInstruction, 1, 6},
    {"<a><?XML x?></a>", InvalidInstruction, 1, 6},
    {"<a><?Xml?></a>", InvalidInstruction, 1, 6},
    {"<a><? p?></a>", InvalidInstruction, 1, 6},
    {"<a><?1?></a>", InvalidInstruction, 1, 6},
    {"<a><?p:q?></a>", InvalidInstruction, 1, 6},
    {"<a><?p+q?></a>", InvalidInstruction, 1, 7},
    {"<a><?p?x?></a>", InvalidInstruction, 1, 7},

    {"<?xml?><a/>", InvalidDeclaration, 1, 6},
    {"<?xml ?><a/>", InvalidDeclaration, 1, 6},
    {"<?xml encoding='utf-8'?><a/>", InvalidDeclaration, 1, 6},
    {"<?xml version='2.0'?><a/>", InvalidDeclaration, 1, 20},
    {"<?xml version='1.'?><a/>", InvalidDeclaration, 1, 19},
    {"<?xml version='1.x'?><a/>", InvalidDeclaration, 1, 20},
    {"<?xml version=1.0?><a/>", InvalidDeclaration, 1, 15},
    {"<?xml version '1.0'?><a/>", InvalidDeclaration, 1, 15},
    {"<?xml version='1.0\"?><a/>", InvalidDeclaration, 1, 15},
    {"<?xml version='1.0'encoding='utf-8'?><a/>", InvalidDeclaration, 1, 20},
    {"<?xml version='1.0' encoding=''?><a/>", InvalidDeclaration, 1, 32},
    {"<?xml version='1.0' encoding='8-bit'?><a/>", InvalidDeclaration, 1, 37},
    {"<?xml version='1.0' encoding='a b'?><a/>", InvalidDeclaration, 1, 35},
    {"<?xml version='1.0' standalone='maybe'?><a/>", InvalidDeclaration, 1, 39},
    {"<?xml version='1.0' standalone='yes' encoding='utf-8'?><a/>", InvalidDeclaration, 1, 38},
    {"<?xml version='1.0' other='1'?><a/>", InvalidDeclaration, 1, 21},
    {"<?xml version='1.0'><a/>", InvalidDeclaration, 1, 20},
    {"<?xml VERSION='1.0'?><a/>", InvalidDeclaration, 1, 6},

    {"<a></a x>", InvalidMarkup, 1, 8},
    {"<a></a/>", InvalidMarkup, 1, 7},
    {"<a/ >", InvalidMarkup, 1, 4},
    {"<a b='1'/x>", InvalidMarkup, 1, 10},
    {"<a><!x></a>", InvalidMarkup, 1, 6},
    {"<a><!-x--></a>", InvalidMarkup, 1, 7},
    {"<a><![cdata[x]]></a>", InvalidMarkup, 1, 7},
    {"<!ELEMENT a ANY><a/>", InvalidMarkup, 1, 3},
    {"<!Doctype a><a/>", InvalidMarkup, 1, 4},

    {"<p:a/>", UndeclaredPrefix, 1, 2},
    {"<a p:b='1'/>", UndeclaredPrefix, 1, 4},
    {"<a><p:b xmlns:p='u'/><p:b/></a>", UndeclaredPrefix, 1, 23},
    {"<a xmlns:p=''/>", UndeclaredPrefix, 1, 4},
    {"<a xmlns:p='u'><b xmlns:p=''/></a>", UndeclaredPrefix, 1, 19},

    {"<xmlns:a/>", ReservedPrefix, 1, 2},
    {"<a xmlns:xmlns='u'/>", ReservedPrefix, 1, 4},
    {"<a xmlns:xml='u'/>", ReservedPrefix, 1, 4},
    {"<a xmlns:p='http://www.w3.org/XML/1998/namespace'/>", ReservedPrefix, 1, 4},
    {"<a xmlns='http://www.w3.org/XML/1998/namespace'/>", ReservedPrefix, 1, 4},
    {"<a xmlns:p='http://www.w3.org/2000/xmlns/'/>", ReservedPrefix, 1, 4},
    {"<a xmlns='http://www.w3.org/2000/xmlns/'/>", ReservedPrefix, 1, 4},

    {"<!DOCTYPE a []><a/>", InternalSubset, 1, 13},
    {"<!DOCTYPE a SYSTEM 'x' [<!ENTITY e 'x'>]><a>&e;</a>", InternalSubset, 1, 24},

    {"<!DOCTYPEa><a/>", InvalidDoctype, 1, 10},
    {"<!DOCTYPE a SYSTEM><a/>", InvalidDoctype, 1, 19},
    {"<!DOCTYPE a SYSTEM x><a/>", InvalidDoctype, 1, 20},
    {"<!DOCTYPE a SYSTEM'x'><a/>", InvalidDoctype, 1, 19},
    {"<!DOCTYPE a PUBLIC 'x'><a/>", InvalidDoctype, 1, 23},
    {"<!DOCTYPE a PUBLIC 'x''y'><a/>", InvalidDoctype, 1, 23},
    {"<!DOCTYPE a PUBLIC '{}' 'y'><a/>", InvalidDoctype, 1, 21},
    {"<!DOCTYPE a x><a/>", InvalidDoctype, 1, 13},
    {"<!DOCTYPE a><!DOCTYPE a><a/>", InvalidDoctype, 1, 13},
    {"<a/><!DOCTYPE a>", InvalidDoctype, 1, 5},
    {"<a><!DOCTYPE a></a>", InvalidDoctype, 1, 4},

    {"<?xml version='1.0' encoding='klingon'?><a/>", UnknownEncoding, 1, 31},
};

void CheckError(const ParseError& error, const Case& expected)
{
    CHECK(static_cast<int>(error.code) == static_cast<int>(expected.code));
    CHECK(error.line == expected.line);
    CHECK(error.column == expected.column);
    CHECK(error.reason != u"");
    CHECK(error.reason.back() != u'.');
    CHECK(error.reason.find(u'%') == std::u16string::npos);
}

std::u16string ReasonFor(std::u16string_view text)
{
    Document document;
    CHECK_FALSE(document.LoadText(text));
    return document.Error().reason;
}

} // namespace

TEST_CASE("Bytes that are not well-formed are refused with code, line and column")
{
    for (const Case& expected : cases) {
        CAPTURE(std::string(expected.bytes));
        Document document;
        CHECK_FALSE(document.LoadBytes(expected.bytes));
        CHECK_FALSE(document.Root());
        CheckError(document.Error(), expected);
    }
}

TEST_CASE("The same texts in 16-bit characters are refused alike")
{
    for (const Case& expected : cases) {
        if (expected.code == InvalidSequence || expected.code == UnknownEncoding) // of bytes only
            continue;
        CAPTURE(std::string(expected.bytes));
        Document document;
        CHECK_FALSE(document.LoadText(ToUtf16(expected.bytes)));
        CheckError(document.Error(), expected);
    }
}

TEST_CASE("Every code but that of a text too large to be written here has its case")
{
    for (int code = 1; code < static_cast<int>(TooLarge); ++code) {
        bool hasCase = false;
        for (const Case& row : cases)
            hasCase |= static_cast<int>(row.code) == code;
        CHECK_MESSAGE(hasCase, code);
    }
}

TEST_CASE("A lone surrogate is refused, wherever it stands")
{
    for (const std::u16string& text : {u"<a>" + std::u16string(1, 0xD800) + u"</a>", u"<a>" + std::u16string(1, 0xDC00),
                                       u"<a>" + std::u16string(1, 0xDBFF), u"<a>" + std::u16string{0xDC00, 0xD800}}) {
        Document document;
        CHECK_FALSE(document.LoadText(text));
        CHECK(document.Error().code == InvalidSequence);
        CHECK(document.Error().column == 4);
    }
}

TEST_CASE("Columns count characters, lines end at CR LF, CR and LF")
{
    Document document;
    CHECK_FALSE(document.LoadBytes("<a>\r\n\r\n\xF0\x9F\x98\x80\xC3\xA9\t&x;"));
    CHECK(document.Error().line == 2 + 1);
    CHECK(document.Error().column == 4);
    CHECK_FALSE(document.LoadText(u"<a>\r\r\n\n\U0001F600\u00E9\t&x;"));
    CHECK(document.Error().line == 4);
    CHECK(document.Error().column == 4);
}

TEST_CASE("The place is in the text as written, also behind references and line ends that are resolved")
{
    Document document;
    CHECK_FALSE(document.LoadText(u"<a b='&amp;&amp;\r\n'>&lt;\r\n&#65;</b>"));
    CHECK(document.Error().line == 3);
    CHECK(document.Error().column == 8);
}

TEST_CASE("A byte order mark is no character of the first line")
{
    Document document;
    CHECK_FALSE(document.LoadBytes("\xEF\xBB\xBFx"));
    CHECK(document.Error().column == 1);
    CHECK_FALSE(document.LoadText(u"\uFEFFx"));
    CHECK(document.Error().column == 1);
}

TEST_CASE("The reason names what was found")
{
    CHECK(ReasonFor(u"<a></b>") == u"The end tag 'b' does not match the start tag 'a'");
    CHECK(ReasonFor(u"<a b='1' b='2'/>") == u"The attribute 'b' is there twice");
    CHECK(ReasonFor(u"<a>&nbsp;</a>") == u"The entity '&nbsp;' is not defined");
    CHECK(ReasonFor(u"<a>\u0001") == u"The character U+0001 is not allowed in XML");
    CHECK(ReasonFor(u"x") == u"The character U+0078 'x' stands outside the root element");
    CHECK(ReasonFor(u"<p:a/>") == u"The prefix 'p' is not declared");
    CHECK(ReasonFor(u"<a><b>") == u"The text ends inside the element 'b'");
    CHECK(ReasonFor(u"<" + std::u16string(100, u'a') + u"></b>")
          == u"The end tag 'b' does not match the start tag '" + std::u16string(60, u'a') + u"...'");
}

} // namespace varnex3::xml
