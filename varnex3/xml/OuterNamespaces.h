// The namespace declarations that a part of a document needs from the elements around it.
#pragma once

#include <algorithm>
#include <cstdint>
#include <vector>

#include "varnex3/xml/NamespaceScope.h"
#include "varnex3/xml/Tree.h"

namespace varnex3::xml {

template <class Char>
class OuterNamespaceFinder
{
public:
    explicit OuterNamespaceFinder(const Tree<Char>& searchedTree) : tree(searchedTree) {}

    // The attributes that declare, above an element, the prefixes that are used in it. In the order they are declared.
    std::vector<std::uint32_t> Find(NodeIndex top)
    {
        DeclareAncestors(top);
        outerCount = scope.Size();
        isUsed.assign(outerCount, false);
        if (outerCount != 0)
            Walk(top);

        std::vector<std::uint32_t> used;
        for (std::size_t i = 0; i < outerCount; ++i)
            if (isUsed[i])
                used.push_back(scope[i].attribute);
        return used;
    }

private:
    using View = std::basic_string_view<Char>;

    void DeclareAncestors(NodeIndex top)
    {
        std::vector<NodeIndex> ancestors;
        for (NodeIndex at = tree.Parent(top); at != documentIndex; at = tree.Parent(at))
            ancestors.push_back(at);
        std::for_each(ancestors.rbegin(), ancestors.rend(), [this](NodeIndex at) { Declare(at); });
    }

    void Walk(NodeIndex top)
    {
        NodeIndex open = tree.Parent(top);
        for (NodeIndex at = top; at < tree.End(top); ++at) {
            for (; open != tree.Parent(at); open = tree.Parent(open))
                scope.Leave(open);
            if (!tree.IsElement(at))
                continue;
            Declare(at);
            UseNames(at);
            open = at;
        }
    }

    void Declare(NodeIndex at)
    {
        for (auto attribute = tree.FirstAttribute(at); attribute; attribute = tree.NextAttribute(attribute)) {
            const View name = tree.AttributeName(*attribute);
            if (IsNamespaceDeclaration(name))
                scope.Declare(name.size() > 5 ? name.substr(6) : View{}, at, Number(*attribute),
                              attribute->valueLength != 0 ? 1 : 0);
        }
    }

    void UseNames(NodeIndex at)
    {
        UsePrefix(PrefixOf(tree.Name(at)));
        for (auto attribute = tree.FirstAttribute(at); attribute; attribute = tree.NextAttribute(attribute))
            if (const View prefix = PrefixOf(tree.AttributeName(*attribute)); !prefix.empty())
                UsePrefix(prefix);
    }

    void UsePrefix(View prefix)
    {
        const std::uint32_t binding = scope.Find(prefix);
        if (binding < outerCount && scope[binding].uri != 0)
            isUsed[binding] = true;
    }

    static View PrefixOf(View name)
    {
        const std::size_t colon = name.find(Char{':'});
        return colon == View::npos ? View{} : name.substr(0, colon);
    }

    std::uint32_t Number(const TreeAttribute& attribute) const
    {
        return static_cast<std::uint32_t>(&attribute - tree.attributes.begin());
    }

    const Tree<Char>& tree;
    NamespaceScope<Char> scope;
    std::size_t outerCount = 0; // bindings from above the element
    std::vector<bool> isUsed;
};

template <class Char>
std::vector<std::uint32_t> OuterNamespaceDeclarations(const Tree<Char>& tree, NodeIndex top)
{
    return OuterNamespaceFinder<Char>(tree).Find(top);
}

} // namespace varnex3::xml
