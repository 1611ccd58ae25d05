// Searches in a tree by element names and child paths.
#pragma once

#include <algorithm>
#include <string>
#include <string_view>

#include "varnex3/xml/Scan.h"
#include "varnex3/xml/Tree.h"
#include "varnex3/xml/Unicode.h"

namespace varnex3::xml {

inline bool SameName(std::string_view name, std::string_view utf8) { return name == utf8; }

// Apart, so that the comparison of most names stays short.
[[gnu::noinline]] inline bool SameDecoded(std::u16string_view name, std::string_view utf8)
{
    const bool isAscii = std::none_of(utf8.begin(), utf8.end(), [](char c) { return Unit(c) >= 0x80; });
    return !isAscii && name == ToUtf16(utf8);
}

inline bool SameName(std::u16string_view name, std::string_view utf8)
{
    if (name.size() > utf8.size()) // a unit takes a byte at least
        return false;
    return (name.size() == utf8.size() && SameAscii(name.data(), utf8.data(), utf8.size())) || SameDecoded(name, utf8);
}

// A path such as "Version/XaloVersion", seen a step at a time. Blanks around a step are ignored.
class Path
{
public:
    explicit Path(std::string_view wholePath) : path(wholePath), stepEnd(std::min(path.find('/'), path.size())) {}

    static Path AtLastStep(std::string_view wholePath)
    {
        Path path(wholePath);
        path.stepEnd = wholePath.size();
        path.stepStart = wholePath.rfind('/') + 1;
        return path;
    }

    std::string_view Step() const
    {
        constexpr std::string_view blanks = " \t\r\n";
        const std::string_view step = path.substr(stepStart, stepEnd - stepStart);
        const std::size_t first = step.find_first_not_of(blanks);
        return first == step.npos ? std::string_view{} : step.substr(first, step.find_last_not_of(blanks) + 1 - first);
    }

    bool IsFirst() const { return stepStart == 0; }
    bool IsLast() const { return stepEnd == path.size(); }

    void Forward()
    {
        stepStart = stepEnd + 1;
        stepEnd = std::min(path.find('/', stepStart), path.size());
    }

    void Back()
    {
        stepEnd = stepStart - 1;
        stepStart = stepEnd == 0 ? 0 : path.rfind('/', stepEnd - 1) + 1;
    }

private:
    std::string_view path;
    std::size_t stepStart = 0;
    std::size_t stepEnd = 0;
};

template <class Char>
bool IsNamed(const Tree<Char>& tree, NodeIndex at, std::string_view name)
{
    return tree.IsElement(at) && SameName(tree.Name(at), name);
}

// The first element of a name among a node and its following siblings.
template <class Char>
NodeIndex FindFrom(const Tree<Char>& tree, NodeIndex at, std::string_view name)
{
    while (at != noNode && !IsNamed(tree, at, name))
        at = tree.NextSibling(at);
    return at;
}

// The elements a path leads to, one after another in document order. Where a step leads nowhere, or all it leads to is
// found, the search goes back to the step before it.
template <class Char>
class PathSearch
{
public:
    PathSearch(const Tree<Char>& searchedTree, NodeIndex from, std::string_view wholePath)
        : tree(searchedTree), path(wholePath), parent(from), at(FindFrom(tree, tree.FirstChild(from), path.Step()))
    {
        Settle();
    }

    // The element found, or noNode when there is none left.
    NodeIndex Found() const { return at; }

    void Next()
    {
        at = FindFrom(tree, tree.NextSibling(at), path.Step());
        Settle();
    }

private:
    void Settle()
    {
        while (at != noNode ? !path.IsLast() : !path.IsFirst())
            at != noNode ? Descend() : Climb();
    }

    void Descend()
    {
        path.Forward();
        parent = at;
        at = FindFrom(tree, tree.FirstChild(parent), path.Step());
    }

    void Climb()
    {
        path.Back();
        at = FindFrom(tree, tree.NextSibling(parent), path.Step());
        parent = tree.Parent(parent);
    }

    const Tree<Char>& tree;
    Path path;
    NodeIndex parent; // whose children are searched
    NodeIndex at;
};

// Whether an element and its ancestors, no further up than `top`, are named as the steps say, last step first.
template <class Char>
bool EndsPath(const Tree<Char>& tree, NodeIndex at, NodeIndex top, Path path)
{
    while (IsNamed(tree, at, path.Step())) {
        if (path.IsFirst())
            return true;
        if (at == top)
            return false;
        path.Back();
        at = tree.Parent(at);
    }
    return false;
}

} // namespace varnex3::xml
