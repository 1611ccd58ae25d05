// Writing a tree without recursion: the nodes lie in document order, and each knows its parent.
#include "varnex3/xml/MarkupWriter.h"

#include <algorithm>

#include "varnex3/xml/OuterNamespaces.h"

namespace varnex3::xml {
namespace {

// The layout ends at this depth, or the indentation would outgrow the content.
constexpr std::size_t deepestIndentation = 100;

} // namespace

template <class Char>
void MarkupWriter<Char>::Document(bool withEncoding)
{
    if (tree.declaration.isPresent)
        Declaration(withEncoding);
    for (NodeIndex at = tree.FirstChild(documentIndex); at != noNode; at = tree.NextSibling(at)) {
        Node(at);
        Ascii("\r\n");
    }
}

template <class Char>
void MarkupWriter<Char>::Declaration(bool withEncoding)
{
    Ascii("<?xml version=\"1.0\"");
    if (withEncoding)
        Ascii(" encoding=\"UTF-8\"");
    if (tree.declaration.hasStandalone)
        Ascii(tree.declaration.isStandalone ? " standalone=\"yes\"" : " standalone=\"no\"");
    Ascii("?>\r\n");
}

template <class Char>
void MarkupWriter<Char>::Node(NodeIndex node)
{
    top = node;
    inheritsPreservation = tree.nodes[tree.Parent(top)].Is(PreservesSpace);
    if (tree.Type(top) != NodeType::Element)
        return Enter(top);

    open = tree.Parent(top);
    inlineEnd = 0;
    depth = 0;
    for (NodeIndex at = top; at < tree.End(top); ++at) {
        CloseUpTo(tree.Parent(at));
        if (at != top && at >= inlineEnd)
            NewLine();
        Enter(at);
    }
    CloseUpTo(tree.Parent(top));
}

template <class Char>
void MarkupWriter<Char>::Enter(NodeIndex at)
{
    switch (tree.Type(at)) {
    case NodeType::Element:
        return StartTag(at);
    case NodeType::Text:
        return Text(at);
    case NodeType::CData:
        return Delimited("<![CDATA[", at, "]]>");
    case NodeType::Comment:
        return Delimited("<!--", at, "-->");
    case NodeType::Instruction:
        return Instruction(at);
    case NodeType::Document:
    case NodeType::None:
        break;
    }
}

// Writes the end tags up to the element that holds the next node.
template <class Char>
void MarkupWriter<Char>::CloseUpTo(NodeIndex parent)
{
    while (open != parent) {
        --depth;
        if (tree.End(open) > inlineEnd)
            NewLine();
        EndTag(open);
        open = tree.Parent(open);
    }
}

template <class Char>
void MarkupWriter<Char>::StartTag(NodeIndex at)
{
    Ascii("<");
    out += tree.Name(at);
    for (const TreeAttribute* attribute = tree.FirstAttribute(at); attribute; attribute = tree.NextAttribute(attribute))
        Attribute(*attribute);
    if (at == top)
        OuterNamespaces();

    const bool hasTextInside = tree.nodes[at].Is(HasTextInside);
    const bool isEmpty = tree.FirstChild(at) == noNode;
    Ascii(isEmpty && tree.nodes[at].Is(IsEmptyTag) ? "/>" : ">");
    if (hasTextInside)
        Text(at | innerText);
    if (hasTextInside || isEmpty) {
        if (!tree.nodes[at].Is(IsEmptyTag))
            EndTag(at);
        return;
    }
    if (at >= inlineEnd && IsWrittenInline(at))
        inlineEnd = tree.End(at);
    open = at;
    ++depth;
}

template <class Char>
void MarkupWriter<Char>::EndTag(NodeIndex at)
{
    Ascii("</");
    out += tree.Name(at);
    Ascii(">");
}

// White space alone would be dropped where xml:space does not reach: there it is written as references.
template <class Char>
void MarkupWriter<Char>::Text(NodeIndex at)
{
    const View content = tree.Content(at);
    const bool isBlank = inheritsPreservation && std::all_of(content.begin(), content.end(), IsBlank<Char>);
    if (!isBlank) {
        out += content;
        return;
    }
    std::u16string resolved;
    tree.AppendText(resolved, at);
    for (const char16_t c : resolved)
        Ascii(c == ' ' ? "&#32;" : c == '\t' ? "&#9;" : "&#10;");
}

template <class Char>
void MarkupWriter<Char>::Delimited(const char* start, NodeIndex at, const char* end)
{
    Ascii(start);
    out += tree.Content(at);
    Ascii(end);
}

template <class Char>
void MarkupWriter<Char>::Instruction(NodeIndex at)
{
    Ascii("<?");
    out += tree.Name(at);
    if (!tree.Content(at).empty())
        Ascii(" ");
    Delimited("", at, "?>");
}

// In its own quotes, so that the value can stay as it is.
template <class Char>
void MarkupWriter<Char>::Attribute(const TreeAttribute& attribute)
{
    const char quote[] = {static_cast<char>(tree.text.Data()[attribute.value - 1]), '\0'};
    Ascii(" ");
    out += tree.AttributeName(attribute);
    Ascii("=");
    Ascii(quote);
    out += tree.RawValue(attribute);
    Ascii(quote);
}

template <class Char>
void MarkupWriter<Char>::OuterNamespaces()
{
    if (tree.hasNamespaces && tree.Parent(top) != documentIndex)
        for (const std::uint32_t attribute : OuterNamespaceDeclarations(tree, top))
            Attribute(tree.attributes[attribute]);
}

template <class Char>
bool MarkupWriter<Char>::IsWrittenInline(NodeIndex at) const
{
    const TreeNode& node = tree.nodes[at];
    const bool preservesSpace = node.Is(PreservesSpace) && (node.Is(HasSpaceAttribute) || !inheritsPreservation);
    return node.Is(IsMixed) || preservesSpace || depth >= deepestIndentation;
}

template <class Char>
void MarkupWriter<Char>::NewLine()
{
    Ascii("\r\n");
    out.append(depth, Char{'\t'});
}

template class MarkupWriter<char>;
template class MarkupWriter<char16_t>;

} // namespace varnex3::xml
