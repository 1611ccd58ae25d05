// An XML document in memory: loaded strictly, read by child paths, written back as markup.
//
//     xml::Document document;
//     if (!document.LoadText(u"<Version><XaloVersion>1.6</XaloVersion></Version>"))
//         Report(document.Error().line, document.Error().reason);
//     document.SelectSingle("Version/XaloVersion").Text();      // u"1.6"
//
// White space that stands alone between two tags is dropped, unless xml:space="preserve" is in force or it came from
// a character reference or a CDATA section; other text is kept to the letter, line ends normalised to LF. Names are
// compared as written, prefix included. Namespaces are checked (an undeclared prefix is an error), not resolved.
// Time and memory grow linearly with the text; depth and the number of attributes are bounded by memory alone.
// A document is not synchronised: one thread at a time.
#pragma once

#include <array>
#include <cstddef>
#include <cstdint>
#include <memory>
#include <string>
#include <string_view>
#include <vector>

#include "varnex3/xml/NameSet.h"
#include "varnex3/xml/ParseError.h"

namespace varnex3::xml {

class Document;

enum class NodeType : std::uint8_t
{
    None,
    Document,
    Element,
    Text,
    CData,
    Comment,
    Instruction
};

// An attribute of an element, namespace declarations not counted. Value: references resolved, white space characters
// normalised to blanks, as XML requires.
struct Attribute
{
    std::u16string name;
    std::u16string value;
};

class Node;
using NodeList = std::vector<Node>;

// One node of a document: a small handle, valid as long as its document is neither reloaded nor destroyed. An absent
// node is a value too: it converts to false, has no name, no text and no children.
class Node
{
public:
    Node() = default;

    explicit operator bool() const { return document != nullptr; }
    NodeType Type() const;

    // The name as written, prefix included; u"#text", u"#comment" and so on for the nodes that have none; u"" for an
    // absent node.
    std::u16string Name() const;

    // Whether the node is an element of this name (UTF-8), without making a text of it.
    bool IsElement(std::string_view name) const;

    // The typed value: all text inside, that of child elements too, in document order; comments and processing
    // instructions skipped, CDATA included, nothing trimmed. The content of a text, comment or instruction node.
    std::u16string Text() const;

    // The same without a copy, where the document has the text as it is; in the given room where it has not.
    std::u16string_view Text(std::u16string& room) const;

    // The node as markup that loads again to the same node, its texts and values with the references and quotes they
    // were written with. Elements that hold only elements are laid out one to a line, indented with TABs, ended with
    // CR LF (100 levels down; deeper ones stay on their line); the markup itself has no line end before or after it.
    // Prefixes that are declared further up are declared again on the node.
    std::u16string Xml() const;

    // Comments and instructions are nodes too; dropped white space is not.
    Node FirstChild() const;
    Node NextSibling() const;

    // The number of attributes, namespace declarations not counted.
    std::size_t AttributeCount() const;

    // The attribute at this position, from 0, in the order written. Precondition: index < AttributeCount().
    Attribute AttributeAt(std::size_t index) const;
    std::u16string AttributeValue(std::size_t index) const;

    // The first element that a child path such as "Version/XaloVersion" leads to: one name a step, from this node
    // (from the document: the first step names the root element). Blanks around a step are ignored. Absent when there
    // is none.
    Node SelectSingle(std::string_view path) const;

    // Every element the path leads to, in document order.
    NodeList Select(std::string_view path) const;

    // Every element below this node with this tag name, in document order. "Parent/Child" finds each Child whose
    // parent is a Parent, at any depth; this node itself may be that parent.
    NodeList ElementsByTagName(std::string_view name) const;

private:
    friend class ChildElements;
    friend class Document;
    Node(const Document* owner, std::uint32_t at) : document(owner), index(at) {}

    const Document* document = nullptr;
    std::uint32_t index = 0;
};

// The elements directly inside a node, by name. They are looked through once; finding one then hardly looks at others.
// Valid as long as the node is.
class ChildElements
{
public:
    explicit ChildElements(const Node& parent);

    // Whether there may be one whose name has this bit (see NameBit); if not, there is none.
    bool MayHave(std::uint8_t bit) const { return Has(bits, bit); }

    // The first one of this name, which is ASCII; absent when there is none. The bit is the name's.
    Node First(std::string_view name, std::uint8_t bit) const;
    Node First(std::string_view name) const { return First(name, NameBit(name)); }

private:
    const Document* document;
    NameSet bits = 0;
    std::array<std::uint32_t, bitsOfNames>
        firsts; // NOLINT(cppcoreguidelines-pro-type-member-init): where the bit is set
};

class Document
{
public:
    // An empty document: no nodes, and the error of an empty text.
    Document();
    ~Document();
    Document(Document&& other) noexcept;
    Document& operator=(Document&& other) noexcept;

    // Loads a text. The encoding its declaration names is not looked at: the text is already characters. False, and
    // an empty document, when it is not well-formed. std::bad_alloc when memory ends; the document is then empty.
    bool LoadText(std::u16string_view text);

    // Loads the bytes of a file: UTF-8 with or without byte order mark, UTF-16 of either order, ISO-8859-1,
    // windows-1252 or US-ASCII when declared; a byte order mark outranks the declaration. Any other encoding is
    // ErrorCode::UnknownEncoding, and the reason names it. A DOCTYPE without internal subset is passed over, nothing
    // external is ever loaded; one with an internal subset is ErrorCode::InternalSubset.
    bool LoadBytes(std::string_view bytes);

    // Loads a file. Throws std::system_error when it cannot be read; the document is then empty.
    bool LoadFile(std::u16string_view path);

    // The outcome of the last load.
    const ParseError& Error() const;

    // The document node, which every path starts from; absent when the document is empty.
    Node Root() const;
    // The root element; absent when the document is empty.
    Node DocumentElement() const;

    // Shorthands for the same on Root().
    Node SelectSingle(std::string_view path) const { return Root().SelectSingle(path); }
    NodeList Select(std::string_view path) const { return Root().Select(path); }
    NodeList ElementsByTagName(std::string_view name) const { return Root().ElementsByTagName(name); }

    // The whole document as text: its XML declaration when it had one, without encoding, then every node as Node::Xml
    // writes it, each ended with CR LF; no DOCTYPE. Loading the text gives the same document. u"" for an empty one.
    std::u16string Xml() const;

    // Saves as UTF-8, atomically; the declaration, when there is one, says so. Throws std::system_error.
    // Precondition: not empty.
    void SaveFile(std::u16string_view path) const;

private:
    friend class ChildElements;
    friend class Node;
    struct Content;
    std::unique_ptr<Content> content;
};

} // namespace varnex3::xml
