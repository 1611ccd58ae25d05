// The parser: strict, without recursion, and without a stack of its own: an open element is found through its
// children's parent numbers. Every function takes the place where a piece of markup starts and returns the place after
// it, or nullptr once a fault is noted.
#include "varnex3/xml/Parser.h"

#include <algorithm>

#include "varnex3/xml/AttributeCheck.h"
#include "varnex3/xml/Declaration.h"
#include "varnex3/xml/Doctype.h"
#include "varnex3/xml/Lexer.h"
#include "varnex3/xml/TreeBuilder.h"

namespace varnex3::xml {
namespace {

// A guess at how much text makes a node; what is too much is given back.
constexpr std::size_t charactersPerNode = 24;
constexpr std::size_t mostNodesGuessed = 4'000'000;

template <class Char>
class Parser
{
public:
    using View = std::basic_string_view<Char>;

    Parser(TextBuffer<Char> text, std::size_t offset)
        : builder(std::move(text)), tree(builder.Built()), lexer(tree.text.View().substr(offset)), check(tree, lexer)
    {}
    Tree<Char> TakeTree() { return std::move(tree); }

    bool Run()
    {
        builder.Start(std::min(Length(lexer.begin, lexer.end) / charactersPerNode, mostNodesGuessed) + 8);
        if (!Document(lexer.begin))
            return false;
        builder.Finish();
        return true;
    }

    ParseError Error() const { return Report(FaultInContext(), View(lexer.begin, Length(lexer.begin, lexer.end))); }

private:
    // ---- the document

    bool Document(const Char* p)
    {
        p = XmlDeclaration(p);
        while (p != nullptr && (p = SkipBlanks(p)) != lexer.end)
            p = TopLevel(p);
        if (p != nullptr && !hasRoot)
            lexer.Fail(ErrorCode::NoRootElement, p, "There is no root element");
        return p != nullptr && hasRoot;
    }

    const Char* XmlDeclaration(const Char* p)
    {
        const View text(p, Length(p, lexer.end));
        if (!Declaration<Char>::StartsIn(text))
            return p;
        const Declaration<Char> declaration(text);
        tree.declaration = declaration.Facts();
        if (!declaration.IsWellFormed())
            return lexer.Unexpected(ErrorCode::InvalidDeclaration, declaration.After(), declaration.Sentence());
        return declaration.After();
    }

    const Char* TopLevel(const Char* p)
    {
        if (*p != '<')
            return lexer.Unexpected(ErrorCode::TextOutsideRoot, p, "The %c stands outside the root element");
        switch (p[1]) {
        case '!':
            return Exclamation(p);
        case '?':
            return Instruction(p);
        case '/':
            return lexer.Fail(ErrorCode::TagMismatch, p + 2, "An end tag stands where no element is open");
        default:
            return RootElement(p);
        }
    }

    const Char* RootElement(const Char* p)
    {
        if (hasRoot && lexer.NameEnd(p + 1) != p + 1)
            return lexer.Fail(ErrorCode::SecondRoot, p, "A second element stands after the root element");
        hasRoot = true;
        p = StartTag(p);
        while (p != nullptr && builder.Current() != documentIndex)
            p = Content(p);
        return p;
    }

    // ---- elements

    // What comes next inside an element.
    [[gnu::always_inline]] const Char* Content(const Char* p)
    {
        p = Text(p);
        if (p == nullptr)
            return nullptr;
        switch (p[1]) {
        case '/':
            return EndTag(p);
        case '!':
            return Exclamation(p);
        case '?':
            return Instruction(p);
        default:
            return StartTag(p);
        }
    }

    [[gnu::always_inline]] const Char* StartTag(const Char* p)
    {
        bool hasPrefix = false;
        const Char* name = p + 1;
        const Char* nameEnd = lexer.Name(name, hasPrefix);
        if (nameEnd == nullptr)
            return nullptr;
        if (*nameEnd != '>' || hasPrefix)
            return LongStartTag(name, nameEnd, hasPrefix);
        if (!IsBlank(nameEnd[1]))
            if (const Char* after = Leaf(name, nameEnd); after != nullptr)
                return after;
        builder.Open(name, nameEnd);
        return nameEnd + 1;
    }

    // <A>text</A> or <A></A>, most elements of a message, in one go. nullptr when it is anything else: the element is
    // then taken again, piece by piece.
    [[gnu::always_inline]] const Char* Leaf(const Char* name, const Char* nameEnd)
    {
        bool needsDecoding = false;
        const Char* text = nameEnd + 1;
        const Char* textEnd = lexer.Text(text, needsDecoding);
        if (textEnd == nullptr || textEnd[1] != '/')
            return nullptr;
        const std::size_t length = Length(name, nameEnd);
        if (!SameCharacters(textEnd + 2, name, length) || textEnd[2 + length] != '>')
            return nullptr;

        builder.AppendLeaf(name, nameEnd, text, textEnd, needsDecoding);
        return textEnd + length + 3;
    }

    // A start tag with attributes, a prefix or "/>".
    [[gnu::noinline]] const Char* LongStartTag(const Char* name, const Char* nameEnd, bool hasPrefix)
    {
        builder.Open(name, nameEnd);
        const Char* p = *nameEnd != '>' ? Attributes(nameEnd) : nameEnd;
        if (p == nullptr || (hasPrefix && !check.ElementName(builder.Current())))
            return nullptr;
        return *p == '>' ? p + 1 : EmptyTag(p);
    }

    // "/>", after the attributes.
    const Char* EmptyTag(const Char* p)
    {
        p = lexer.Expect(p + 1, ">", ErrorCode::InvalidMarkup, "The %c stands between '/' and '>'");
        if (p == nullptr)
            return nullptr;
        builder.MarkEmptyTag();
        Close();
        return p;
    }

    [[gnu::always_inline]] const Char* EndTag(const Char* p)
    {
        const View name = tree.Name(builder.Current());
        const Char* after = p + 2 + name.size();
        if (!SameCharacters(p + 2, name.data(), name.size()) || (*after != '>' && !IsBlank(*after)))
            return Mismatch(p + 2);
        after = SkipBlanks(after);
        if (*after != '>')
            return lexer.Unexpected(ErrorCode::InvalidMarkup, after, "The %c stands in an end tag");
        Close();
        return after + 1;
    }

    [[gnu::cold]] const Char* Mismatch(const Char* name)
    {
        bool hasPrefix = false;
        const Char* after = lexer.Name(name, hasPrefix);
        if (after == nullptr)
            return nullptr;
        if (after == lexer.end)
            return lexer.Fail(ErrorCode::UnexpectedEnd, after, "");
        const View found(name, Length(name, after));
        if (found == tree.Name(builder.Current()))
            return lexer.Unexpected(ErrorCode::InvalidMarkup, after, "The %c stands in an end tag");
        return lexer.Fail(ErrorCode::TagMismatch, name, "The end tag '%1' does not match the start tag '%2'", found,
                          tree.Name(builder.Current()));
    }

    void Close()
    {
        check.Leave(builder.Current());
        builder.Close();
    }

    // ---- attributes

    // From behind the element's name to the ">" or "/" that ends the list.
    const Char* Attributes(const Char* p)
    {
        const std::size_t first = tree.attributes.Size();
        bool hasPrefixes = false;
        for (const Char* next = SkipBlanks(p); *next != '>' && *next != '/'; next = SkipBlanks(p)) {
            if (next == p)
                return NoBlank(p, first == tree.attributes.Size());
            p = Attribute(next, hasPrefixes);
            if (p == nullptr)
                return nullptr;
        }
        return EndAttributes(first, hasPrefixes) ? SkipBlanks(p) : nullptr;
    }

    std::nullptr_t NoBlank(const Char* p, bool isAfterName)
    {
        return isAfterName ? lexer.Unexpected(ErrorCode::InvalidName, p, "The %c is not allowed in a name")
                           : lexer.Unexpected(ErrorCode::InvalidAttribute, p, "The %c follows a value without a blank");
    }

    const Char* Attribute(const Char* name, bool& hasPrefixes)
    {
        bool hasPrefix = false;
        const Char* nameEnd = lexer.Name(name, hasPrefix);
        const Char* quote = nameEnd != nullptr ? Quote(nameEnd) : nullptr;
        if (quote == nullptr)
            return nullptr;
        bool needsDecoding = false;
        const Char* valueEnd = lexer.Value(quote + 1, *quote, needsDecoding);
        if (valueEnd == nullptr)
            return nullptr;

        const View attributeName(name, Length(name, nameEnd));
        const View value(quote + 1, Length(quote + 1, valueEnd));
        const TreeAttribute& attribute = builder.AppendAttribute(attributeName, value, needsDecoding);
        hasPrefixes |= hasPrefix || IsNamespaceDeclaration(attributeName);
        if (hasPrefix && EqualsAscii(attributeName, "xml:space"))
            builder.SetSpace(attribute);
        return valueEnd + 1;
    }

    // From behind an attribute's name to the quote that opens its value.
    const Char* Quote(const Char* p)
    {
        p = lexer.Expect(SkipBlanks(p), "=", ErrorCode::InvalidAttribute, "The %c stands where '=' is wanted");
        if (p == nullptr)
            return nullptr;
        p = SkipBlanks(p);
        if (*p != '"' && *p != '\'')
            return lexer.Unexpected(ErrorCode::InvalidAttribute, p, "The %c stands where a quote is wanted");
        return p;
    }

    bool EndAttributes(std::size_t first, bool hasPrefixes)
    {
        const std::size_t count = tree.attributes.Size() - first;
        if (count == 0)
            return true;
        builder.EndAttributes(first);
        return (count == 1 && !hasPrefixes) || check.Attributes(builder.Current(), first, hasPrefixes);
    }

    // ---- text and the other markup

    // Up to the next "<".
    [[gnu::always_inline]] const Char* Text(const Char* p)
    {
        if (IsBlank(*p)) {
            const Char* next = SkipBlanks(p);
            if (*next == '<' && !builder.PreservesBlanks())
                return next;
        }
        bool needsDecoding = false;
        const Char* after = lexer.Text(p, needsDecoding);
        if (after != nullptr && after != p)
            builder.AppendText(p, after, needsDecoding, after[1] == '/');
        return after;
    }

    const Char* Exclamation(const Char* p)
    {
        switch (p[2]) {
        case '-':
            return Comment(p);
        case '[':
            return CDataSection(p);
        case 'D':
            return DoctypeDeclaration(p);
        default:
            return lexer.Unexpected(ErrorCode::InvalidMarkup, p + 2, "The %c follows '<!'");
        }
    }

    const Char* Comment(const Char* p)
    {
        const Char* content = lexer.Expect(p, "<!--", ErrorCode::InvalidMarkup, "A comment starts with '<!--'");
        if (content == nullptr)
            return nullptr;
        bool needsDecoding = false;
        const Char* after = lexer.Find(content, "--", needsDecoding);
        if (after == nullptr)
            return nullptr;
        builder.AppendNode(NodeType::Comment, content, after, needsDecoding);
        return lexer.Expect(after + 2, ">", ErrorCode::InvalidComment, "The characters '--' stand in a comment");
    }

    const Char* CDataSection(const Char* p)
    {
        if (builder.Current() == documentIndex)
            return lexer.Fail(ErrorCode::TextOutsideRoot, p, "A CDATA section stands outside the root element");
        const Char* content =
            lexer.Expect(p, "<![CDATA[", ErrorCode::InvalidMarkup, "A section starts with '<![CDATA['");
        if (content == nullptr)
            return nullptr;
        bool needsDecoding = false;
        const Char* after = lexer.Find(content, "]]>", needsDecoding);
        if (after == nullptr)
            return nullptr;
        builder.AppendNode(NodeType::CData, content, after, needsDecoding);
        return after + 3;
    }

    const Char* Instruction(const Char* p)
    {
        const Char* target = p + 2;
        const Char* targetEnd = InstructionTarget(target);
        if (targetEnd == nullptr)
            return nullptr;
        const Char* content = SkipBlanks(targetEnd);
        if (content == targetEnd && !lexer.StartsWith(content, "?>"))
            return lexer.Unexpected(ErrorCode::InvalidInstruction, content,
                                    "The %c follows the name of a processing instruction");
        bool needsDecoding = false;
        const Char* after = lexer.Find(content, "?>", needsDecoding);
        if (after == nullptr)
            return nullptr;
        builder.AppendNode(NodeType::Instruction, content, after, needsDecoding);
        builder.SetLastName(target, targetEnd);
        return after + 2;
    }

    const Char* InstructionTarget(const Char* p)
    {
        const Char* after = lexer.NameEnd(p);
        const View target(p, Length(p, after));
        if (target.empty())
            return lexer.Unexpected(ErrorCode::InvalidInstruction, p, "A processing instruction cannot start with %c");
        if (target.find(Char{':'}) != View::npos)
            return lexer.Fail(ErrorCode::InvalidInstruction, p, "The processing instruction '%1' has a colon", target);
        if (EqualsAscii(target, "xml"))
            return lexer.Fail(ErrorCode::InvalidInstruction, p, "An XML declaration stands only at the very start");
        if (target.size() == 3 && (Unit(p[0]) | 0x20) == 'x' && (Unit(p[1]) | 0x20) == 'm'
            && (Unit(p[2]) | 0x20) == 'l')
            return lexer.Fail(ErrorCode::InvalidInstruction, p, "The name '%1' is reserved", target);
        return after;
    }

    const Char* DoctypeDeclaration(const Char* p)
    {
        if (hasRoot || hasDoctype)
            return lexer.Fail(ErrorCode::InvalidDoctype, p, "A DOCTYPE stands once, before the root element");
        hasDoctype = true;
        return Doctype<Char>(lexer).Read(p);
    }

    // ---- the rest

    static std::size_t Length(const Char* p, const Char* after) { return static_cast<std::size_t>(after - p); }
    Fault<Char> FaultInContext() const
    {
        Fault<Char> fault = lexer.fault;
        if (fault.code == ErrorCode::UnexpectedEnd && builder.Current() != documentIndex) {
            fault.sentence = "The text ends inside the element '%1'";
            fault.first = tree.Name(builder.Current());
        }
        return fault;
    }

    TreeBuilder<Char> builder;
    Tree<Char>& tree; // the one that is built
    Lexer<Char> lexer;
    AttributeCheck<Char> check;
    bool hasRoot = false;
    bool hasDoctype = false;
};

} // namespace

template <class Char>
ParseError Parse(TextBuffer<Char> text, std::size_t offset, Tree<Char>& into)
{
    Parser<Char> parser(std::move(text), offset);
    if (!parser.Run())
        return parser.Error();
    into = parser.TakeTree();
    return {};
}

template ParseError Parse(TextBuffer<char>, std::size_t, Tree<char>&);
template ParseError Parse(TextBuffer<char16_t>, std::size_t, Tree<char16_t>&);

} // namespace varnex3::xml
