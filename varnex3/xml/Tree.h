// The nodes of one document over its own text, in document order: the first child of a node is the node after it, its
// descendants end where its next sibling starts. Names and texts are places in the text, which stays as it was
// written; references and line ends are resolved when a text is read.
#pragma once

#include <cstdint>
#include <string>
#include <string_view>

#include "varnex3/xml/Document.h"
#include "varnex3/xml/PlainArray.h"
#include "varnex3/xml/References.h"
#include "varnex3/xml/TextBuffer.h"

namespace varnex3::xml {

using NodeIndex = std::uint32_t;

// The document node; as the answer to a search, nothing.
inline constexpr NodeIndex documentIndex = 0;
inline constexpr NodeIndex noNode = 0;

// The text node that an element holds inside itself has the element's index and this bit.
inline constexpr NodeIndex innerText = 0x80000000;

enum NodeFlag : std::uint8_t
{
    NeedsDecoding = 1,      // the text has references or carriage returns
    HasTextInside = 2,      // an element whose only child is a text, held in the element's own node
    IsMixed = 4,            // an element with a text or CDATA section among its children
    PreservesSpace = 8,     // xml:space="preserve" is in force inside
    HasSpaceAttribute = 16, // the element itself says so, or ends it
    IsEmptyTag = 32,        // written <A/>, not <A></A>
    HasAttributes = 64,
};

struct TreeNode
{
    NodeIndex parent;
    std::uint32_t name; // elements and instructions
    std::uint32_t text; // where the content starts
    // The length of the content; of an element without text inside, the index after its last descendant.
    std::uint32_t extent;
    std::uint32_t firstAttribute;
    std::uint16_t nameLength; // see Tree::NameAt
    NodeType type;
    std::uint8_t flags;

    bool Is(NodeFlag flag) const { return (flags & flag) != 0; }
};
static_assert(sizeof(TreeNode) == 24);

struct TreeAttribute
{
    std::uint32_t name;
    std::uint32_t value;
    std::uint32_t valueLength;
    std::uint16_t nameLength;
    bool needsDecoding;
    bool isLast; // of its element
};
static_assert(sizeof(TreeAttribute) == 16);

// What the XML declaration said.
struct DeclarationFacts
{
    bool isPresent = false;
    bool hasStandalone = false;
    bool isStandalone = false;
};

template <class Char>
class Tree
{
public:
    using View = std::basic_string_view<Char>;

    Tree() = default;
    explicit Tree(TextBuffer<Char> buffer) : text(std::move(buffer)) {}

    NodeType Type(NodeIndex at) const { return IsInnerText(at) ? NodeType::Text : nodes[at].type; }
    View Name(NodeIndex at) const { return NameAt(nodes[at].name, nodes[at].nameLength); }
    bool IsElement(NodeIndex at) const { return Type(at) == NodeType::Element; }

    NodeIndex Parent(NodeIndex at) const { return IsInnerText(at) ? at & ~innerText : nodes[at].parent; }

    // The index after the last descendant of a node.
    NodeIndex End(NodeIndex at) const
    {
        if (IsInnerText(at))
            return at + 1;
        const TreeNode& node = nodes[at];
        const bool hasDescendants = node.type <= NodeType::Element && !node.Is(HasTextInside);
        return hasDescendants ? node.extent : at + 1;
    }

    NodeIndex FirstChild(NodeIndex at) const
    {
        if (IsInnerText(at))
            return noNode;
        if (nodes[at].Is(HasTextInside))
            return at | innerText;
        return at + 1 < End(at) ? at + 1 : noNode;
    }

    NodeIndex NextSibling(NodeIndex at) const
    {
        if (IsInnerText(at))
            return noNode;
        const NodeIndex next = End(at);
        return next < nodes.Size() && nodes[next].parent == nodes[at].parent ? next : noNode;
    }

    // The content of a text, comment or instruction, or the text inside an element, as it is written.
    View Content(NodeIndex at) const
    {
        const TreeNode& node = nodes[at & ~innerText];
        return {text.Data() + node.text, node.extent};
    }

    // Whether a node is an element with a text alone, which stands in the document as it is meant.
    bool IsPlainLeaf(NodeIndex at) const
    {
        return !IsInnerText(at) && (nodes[at].flags & (HasTextInside | NeedsDecoding)) == HasTextInside;
    }

    // Appends all text inside a node; of a comment or instruction, its content.
    void AppendText(std::u16string& to, NodeIndex at) const;

    const TreeAttribute* FirstAttribute(NodeIndex at) const
    {
        const bool hasAny = !IsInnerText(at) && nodes[at].Is(HasAttributes);
        return hasAny ? &attributes[nodes[at].firstAttribute] : nullptr;
    }
    static const TreeAttribute* NextAttribute(const TreeAttribute* at) { return at->isLast ? nullptr : at + 1; }
    View AttributeName(const TreeAttribute& at) const { return NameAt(at.name, at.nameLength); }
    View RawValue(const TreeAttribute& at) const { return {text.Data() + at.value, at.valueLength}; }
    void AppendValue(std::u16string& to, const TreeAttribute& at) const;

    // What the parser fills.
    TextBuffer<Char> text;
    PlainArray<TreeNode> nodes;
    PlainArray<TreeAttribute> attributes;
    DeclarationFacts declaration;
    bool hasNamespaces = false; // an xmlns attribute somewhere

    // Names of 65,535 characters and more have this length: the text itself tells where they end.
    static constexpr std::uint16_t longName = 0xFFFF;

private:
    static bool IsInnerText(NodeIndex at) { return (at & innerText) != 0; }

    View NameAt(std::uint32_t offset, std::uint16_t length) const
    {
        const Char* name = text.Data() + offset;
        return {name, length != longName ? length : LongNameLength(name)};
    }

    static std::size_t LongNameLength(const Char* name)
    {
        const Char* end = name + longName;
        while (!IsBlank(*end) && *end != '>' && *end != '/' && *end != '=' && *end != '?')
            ++end;
        return static_cast<std::size_t>(end - name);
    }
};

// Whether an attribute declares a namespace.
template <class Char>
bool IsNamespaceDeclaration(std::basic_string_view<Char> name)
{
    return EqualsAscii(name.substr(0, 5), "xmlns") && (name.size() == 5 || name[5] == ':');
}

template <class Char>
void Tree<Char>::AppendText(std::u16string& to, NodeIndex at) const
{
    const auto appendContent = [&](NodeIndex index) {
        const bool isPlain = !nodes[index & ~innerText].Is(NeedsDecoding);
        isPlain ? AppendPlain(to, Content(index)) : AppendContent(to, Content(index), Type(index));
    };
    if (Type(at) > NodeType::Element)
        return appendContent(at);

    for (NodeIndex i = at; i < End(at); ++i)
        if (nodes[i].Is(HasTextInside) || nodes[i].type == NodeType::Text || nodes[i].type == NodeType::CData)
            appendContent(i);
}

template <class Char>
void Tree<Char>::AppendValue(std::u16string& to, const TreeAttribute& at) const
{
    at.needsDecoding ? AppendAttributeValue(to, RawValue(at)) : AppendPlain(to, RawValue(at));
}

} // namespace varnex3::xml
