// What can be said of an element's names only once its start tag is complete: prefixes are declared, and no attribute
// is there twice.
#pragma once

#include <deque>
#include <string>
#include <unordered_map>

#include "varnex3/xml/Lexer.h"
#include "varnex3/xml/NamespaceScope.h"
#include "varnex3/xml/Tree.h"
#include "varnex3/xml/Unicode.h"

namespace varnex3::xml {

template <class Char>
class AttributeCheck
{
public:
    using View = std::basic_string_view<Char>;

    AttributeCheck(Tree<Char>& checkedTree, Lexer<Char>& noteFaultsIn) : tree(checkedTree), lexer(noteFaultsIn) {}

    // Checks the attributes of an element from this one on, the last there are. False once a fault is noted.
    bool Attributes(NodeIndex element, std::size_t first, bool hasPrefixes);

    // Checks the name, with a prefix, of an element whose attributes are checked.
    bool ElementName(NodeIndex element);

    // To be called at the end of every element.
    void Leave(NodeIndex element)
    {
        if (!scope.IsEmpty())
            scope.Leave(element);
    }

private:
    // A namespace, by number, and the name in it.
    struct ExpandedName
    {
        std::uint32_t uri;
        View local;
        bool operator==(const ExpandedName& other) const { return uri == other.uri && local == other.local; }
    };

    static constexpr std::uint32_t noUri = 0;
    static constexpr std::uint32_t xmlUri = 1;
    static constexpr std::uint32_t xmlnsUri = 2;
    static constexpr std::uint32_t firstOtherUri = 3;
    static constexpr std::uint32_t unknownUri = 0xFFFFFFFF;
    static constexpr std::size_t handful = 8;

    bool Declare(NodeIndex element, std::size_t attribute);
    bool IsAllowed(View prefix, std::uint32_t uri, const Char* at);
    std::uint32_t UriNumber(const TreeAttribute& attribute);
    View UriOf(const TreeAttribute& attribute);
    std::uint32_t UriOfPrefix(View prefix) const;
    bool Expand(View name, ExpandedName& expanded);
    bool ExpandAll(std::size_t first, bool hasPrefixes);
    bool AreDifferent(std::size_t first);
    bool AreDifferentByHash(std::size_t first);
    bool FailDuplicate(std::size_t attribute);

    Tree<Char>& tree;
    Lexer<Char>& lexer;
    NamespaceScope<Char> scope;
    std::unordered_map<View, std::uint32_t> uriNumbers; // of the namespaces that are not reserved
    std::deque<std::basic_string<Char>> decodedUris;    // those that do not stand in the text as they are
    PlainArray<ExpandedName> names;                     // of the attributes of one element
    PlainArray<std::uint32_t> places;                   // a hash table of numbers in `names`
};

template <class Char>
bool AttributeCheck<Char>::Attributes(NodeIndex element, std::size_t first, bool hasPrefixes)
{
    if (hasPrefixes)
        for (std::size_t i = first; i < tree.attributes.Size(); ++i)
            if (IsNamespaceDeclaration(tree.AttributeName(tree.attributes[i])) && !Declare(element, i))
                return false;
    return ExpandAll(first, hasPrefixes) && AreDifferent(first);
}

template <class Char>
bool AttributeCheck<Char>::ElementName(NodeIndex element)
{
    ExpandedName expanded{};
    const View name = tree.Name(element);
    if (EqualsAscii(name.substr(0, name.find(Char{':'})), "xmlns"))
        return lexer.FailFalse(ErrorCode::ReservedPrefix, name.data(),
                               "The prefix 'xmlns' cannot be used for an element");
    return Expand(name, expanded);
}

template <class Char>
bool AttributeCheck<Char>::Declare(NodeIndex element, std::size_t attribute)
{
    tree.hasNamespaces = true;
    const View name = tree.AttributeName(tree.attributes[attribute]);
    const View prefix = name.size() > 5 ? name.substr(6) : View{};
    const std::uint32_t uri = UriNumber(tree.attributes[attribute]);
    if (!IsAllowed(prefix, uri, name.data()))
        return false;
    scope.Declare(prefix, element, static_cast<std::uint32_t>(attribute), uri);
    return true;
}

template <class Char>
bool AttributeCheck<Char>::IsAllowed(View prefix, std::uint32_t uri, const Char* at)
{
    const bool isXml = EqualsAscii(prefix, "xml");
    if (isXml != (uri == xmlUri))
        return lexer.FailFalse(ErrorCode::ReservedPrefix, at,
                               isXml ? "The prefix 'xml' cannot be bound to another namespace"
                                     : "The namespace of 'xml' cannot be bound to another prefix");
    if (EqualsAscii(prefix, "xmlns") || uri == xmlnsUri)
        return lexer.FailFalse(ErrorCode::ReservedPrefix, at,
                               "The prefix 'xmlns' and its namespace cannot be declared");
    if (uri == noUri && !prefix.empty())
        return lexer.FailFalse(ErrorCode::UndeclaredPrefix, at, "The prefix '%1' is declared without a namespace",
                               prefix);
    return true;
}

template <class Char>
std::uint32_t AttributeCheck<Char>::UriNumber(const TreeAttribute& attribute)
{
    const View uri = UriOf(attribute);
    if (uri.empty())
        return noUri;
    if (EqualsAscii(uri, "http://www.w3.org/XML/1998/namespace"))
        return xmlUri;
    if (EqualsAscii(uri, "http://www.w3.org/2000/xmlns/"))
        return xmlnsUri;
    const auto next = firstOtherUri + static_cast<std::uint32_t>(uriNumbers.size());
    return uriNumbers.try_emplace(uri, next).first->second;
}

template <class Char>
std::basic_string_view<Char> AttributeCheck<Char>::UriOf(const TreeAttribute& attribute)
{
    if (!attribute.needsDecoding)
        return tree.RawValue(attribute);
    std::u16string uri;
    tree.AppendValue(uri, attribute);
    if constexpr (sizeof(Char) == 1)
        return decodedUris.emplace_back(ToUtf8(uri));
    else
        return decodedUris.emplace_back(std::move(uri));
}

template <class Char>
std::uint32_t AttributeCheck<Char>::UriOfPrefix(View prefix) const
{
    if (EqualsAscii(prefix, "xml"))
        return xmlUri;
    if (EqualsAscii(prefix, "xmlns"))
        return xmlnsUri;
    const std::uint32_t binding = scope.Find(prefix);
    return binding == scope.none ? unknownUri : scope[binding].uri;
}

template <class Char>
bool AttributeCheck<Char>::Expand(View name, ExpandedName& expanded)
{
    const std::size_t colon = name.find(Char{':'});
    expanded = {noUri, name};
    if (colon == View::npos)
        return true;

    const View prefix = name.substr(0, colon);
    expanded = {UriOfPrefix(prefix), name.substr(colon + 1)};
    if (expanded.uri == unknownUri)
        return lexer.FailFalse(ErrorCode::UndeclaredPrefix, name.data(), "The prefix '%1' is not declared", prefix);
    return true;
}

template <class Char>
bool AttributeCheck<Char>::ExpandAll(std::size_t first, bool hasPrefixes)
{
    names.Clear();
    for (std::size_t i = first; i < tree.attributes.Size(); ++i) {
        ExpandedName& expanded = names.Append({noUri, tree.AttributeName(tree.attributes[i])});
        if (hasPrefixes && !Expand(expanded.local, expanded))
            return false;
    }
    return true;
}

template <class Char>
bool AttributeCheck<Char>::AreDifferent(std::size_t first)
{
    if (names.Size() > handful)
        return AreDifferentByHash(first);
    for (std::size_t i = 1; i < names.Size(); ++i)
        for (std::size_t k = 0; k < i; ++k)
            if (names[i] == names[k])
                return FailDuplicate(first + i);
    return true;
}

template <class Char>
bool AttributeCheck<Char>::AreDifferentByHash(std::size_t first)
{
    constexpr std::uint32_t free = 0xFFFFFFFF;
    std::size_t size = 16;
    while (size < names.Size() * 2)
        size *= 2;
    places.Fill(size, free);

    for (std::size_t i = 0; i < names.Size(); ++i) {
        std::size_t place = PlaceOf(HashOf(names[i].local, HashSeed() + names[i].uri), size);
        for (; places[place] != free; place = (place + 1) & (size - 1))
            if (names[places[place]] == names[i])
                return FailDuplicate(first + i);
        places[place] = static_cast<std::uint32_t>(i);
    }
    return true;
}

template <class Char>
bool AttributeCheck<Char>::FailDuplicate(std::size_t attribute)
{
    const View name = tree.AttributeName(tree.attributes[attribute]);
    return lexer.FailFalse(ErrorCode::DuplicateAttribute, name.data(), "The attribute '%1' is there twice", name);
}

} // namespace varnex3::xml
