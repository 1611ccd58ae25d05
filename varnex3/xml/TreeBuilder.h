// Fills a tree from start tag to end tag: knows the innermost open element, and what its children inherit.
#pragma once

#include <algorithm>
#include <cstdint>
#include <utility>

#include "varnex3/xml/Tree.h"

namespace varnex3::xml {

template <class Char>
class TreeBuilder
{
public:
    using View = std::basic_string_view<Char>;

    explicit TreeBuilder(TextBuffer<Char> text) : tree(std::move(text)) {}

    Tree<Char>& Built() { return tree; }
    const Tree<Char>& Built() const { return tree; }

    // The innermost open element, or the document.
    NodeIndex Current() const { return current; }
    bool PreservesBlanks() const { return (inherited & PreservesSpace) != 0; }

    void Start(std::size_t expectedNodes)
    {
        tree.nodes.Reserve(expectedNodes);
        tree.nodes.Append(NewNode(NodeType::Document));
    }

    void Finish()
    {
        tree.nodes[documentIndex].extent = NodeCount();
        tree.nodes.Shrink();
        tree.attributes.Shrink();
    }

    void Open(const Char* name, const Char* nameEnd)
    {
        const NodeIndex element = NodeCount();
        tree.nodes.Append(NewElement(name, nameEnd));
        current = element;
    }

    void Close()
    {
        TreeNode& element = tree.nodes[current];
        if (!element.Is(HasTextInside))
            element.extent = NodeCount();
        current = element.parent;
        inherited = tree.nodes[current].flags & PreservesSpace;
    }

    // An element with nothing but a text, or with nothing.
    void AppendLeaf(const Char* name, const Char* nameEnd, const Char* text, const Char* textEnd, bool needsDecoding)
    {
        TreeNode node = NewElement(name, nameEnd);
        if (textEnd != text) {
            SetContent(node, text, textEnd, needsDecoding);
            node.flags |= HasTextInside;
        } else {
            node.extent = NodeCount() + 1;
        }
        tree.nodes.Append(node);
    }

    // A text in front of an end tag, or in front of other markup.
    void AppendText(const Char* text, const Char* textEnd, bool needsDecoding, bool isBeforeEndTag)
    {
        const bool isOnlyChild = isBeforeEndTag && NodeCount() == current + 1;
        if (!isOnlyChild)
            return AppendNode(NodeType::Text, text, textEnd, needsDecoding);
        SetContent(tree.nodes[current], text, textEnd, needsDecoding);
        tree.nodes[current].flags |= HasTextInside;
    }

    void AppendNode(NodeType type, const Char* content, const Char* contentEnd, bool needsDecoding)
    {
        if (type == NodeType::Text || type == NodeType::CData)
            tree.nodes[current].flags |= IsMixed;
        SetContent(tree.nodes.Append(NewNode(type)), content, contentEnd, needsDecoding);
    }

    // Names the node that was appended last.
    void SetLastName(const Char* name, const Char* nameEnd) { SetName(tree.nodes.Back(), name, nameEnd); }

    void MarkEmptyTag() { tree.nodes[current].flags |= IsEmptyTag; }

    const TreeAttribute& AppendAttribute(View name, View value, bool needsDecoding)
    {
        return tree.attributes.Append({.name = Offset(name.data()),
                                       .value = Offset(value.data()),
                                       .valueLength = static_cast<std::uint32_t>(value.size()),
                                       .nameLength = ShortLength(name.size()),
                                       .needsDecoding = needsDecoding,
                                       .isLast = false});
    }

    // The attributes from this one on, at least one, belong to the open element.
    void EndAttributes(std::size_t first)
    {
        tree.nodes[current].flags |= HasAttributes;
        tree.nodes[current].firstAttribute = static_cast<std::uint32_t>(first);
        tree.attributes.Back().isLast = true;
    }

    // What xml:space says; other values than the two are as good as none.
    void SetSpace(const TreeAttribute& attribute)
    {
        std::u16string value;
        tree.AppendValue(value, attribute);
        std::uint8_t& flags = tree.nodes[current].flags;
        if (value == u"preserve")
            flags |= PreservesSpace | HasSpaceAttribute;
        else if (value == u"default")
            flags = static_cast<std::uint8_t>((flags & ~PreservesSpace) | HasSpaceAttribute);
        inherited = flags & PreservesSpace;
    }

private:
    NodeIndex NodeCount() const { return static_cast<NodeIndex>(tree.nodes.Size()); }

    TreeNode NewNode(NodeType type) const
    {
        return {.parent = current,
                .name = 0,
                .text = 0,
                .extent = 0,
                .firstAttribute = 0,
                .nameLength = 0,
                .type = type,
                .flags = inherited};
    }

    TreeNode NewElement(const Char* name, const Char* nameEnd) const
    {
        TreeNode node = NewNode(NodeType::Element);
        SetName(node, name, nameEnd);
        return node;
    }

    void SetName(TreeNode& node, const Char* name, const Char* nameEnd) const
    {
        node.name = Offset(name);
        node.nameLength = ShortLength(static_cast<std::size_t>(nameEnd - name));
    }

    void SetContent(TreeNode& node, const Char* content, const Char* contentEnd, bool needsDecoding) const
    {
        node.text = Offset(content);
        node.extent = static_cast<std::uint32_t>(contentEnd - content);
        node.flags |= needsDecoding ? NeedsDecoding : 0;
    }

    std::uint32_t Offset(const Char* p) const { return static_cast<std::uint32_t>(p - tree.text.Data()); }
    static std::uint16_t ShortLength(std::size_t length)
    {
        return static_cast<std::uint16_t>(std::min<std::size_t>(length, Tree<Char>::longName));
    }

    Tree<Char> tree;
    NodeIndex current = documentIndex;
    std::uint8_t inherited = 0; // the flags that children of the open element start with
};

} // namespace varnex3::xml
