// A tree, or a part of it, as markup again: names, texts and attribute values as they were written, the white space
// between the tags in one layout.
#pragma once

#include <string>
#include <string_view>

#include "varnex3/xml/NamespaceScope.h"
#include "varnex3/xml/Tree.h"

namespace varnex3::xml {

template <class Char>
class MarkupWriter
{
public:
    MarkupWriter(const Tree<Char>& writtenTree, std::basic_string<Char>& appendTo) : tree(writtenTree), out(appendTo) {}

    // Every node, each on its own line; the XML declaration before them, with the encoding UTF-8 or with none.
    void Document(bool withEncoding);

    // One node and what is inside it.
    void Node(NodeIndex top);

private:
    using View = std::basic_string_view<Char>;

    void Declaration(bool withEncoding);
    void Enter(NodeIndex at);
    void CloseUpTo(NodeIndex parent);
    void StartTag(NodeIndex at);
    void EndTag(NodeIndex at);
    void Text(NodeIndex at);
    void Delimited(const char* start, NodeIndex at, const char* end);
    void Instruction(NodeIndex at);
    void Attribute(const TreeAttribute& attribute);
    void OuterNamespaces();
    bool IsWrittenInline(NodeIndex at) const;
    void NewLine();
    void Ascii(std::string_view text) { out.append(text.begin(), text.end()); }

    const Tree<Char>& tree;
    std::basic_string<Char>& out;
    NodeIndex top = documentIndex;     // the node that is written
    NodeIndex open = documentIndex;    // the innermost element whose end tag is to come
    NodeIndex inlineEnd = 0;           // no layout up to this node
    std::size_t depth = 0;             // of `open` below `top`, plus 1
    bool inheritsPreservation = false; // of white space, from above `top`
};

} // namespace varnex3::xml
