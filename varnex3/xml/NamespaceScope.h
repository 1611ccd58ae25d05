// The namespace prefixes in scope while a document is walked from start tag to end tag. Finding one takes the same time
// however many there are.
#pragma once

#include <algorithm>
#include <cstddef>
#include <cstdint>
#include <string_view>

#include "varnex3/xml/PlainArray.h"
#include "varnex3/xml/Tree.h"

namespace varnex3::xml {

// A hash of a name. The seed keeps anyone from preparing names that all collide.
template <class Char>
std::uint64_t HashOf(std::basic_string_view<Char> name, std::uint64_t seed)
{
    std::uint64_t hash = seed ^ 0xCBF29CE484222325u;
    for (const Char c : name)
        hash = (hash ^ Unit(c)) * 0x100000001B3u;
    return hash ^ hash >> 29;
}

// Where a hash is in a table of so many places, a power of two. The lowest bits depend on the whole hash: it does not
// matter that a 32-bit system has no table that needs more of them.
inline std::size_t PlaceOf(std::uint64_t hash, std::size_t places)
{
    return static_cast<std::size_t>(hash) & (places - 1);
}

inline std::uint64_t HashSeed()
{
    static const char place{};
    return reinterpret_cast<std::uintptr_t>(&place) * 0x9E3779B97F4A7C15u; // where the system loaded the library
}

template <class Char>
struct NamespaceBinding
{
    std::basic_string_view<Char> prefix; // empty: the default namespace
    NodeIndex element;                   // that declares it
    std::uint32_t attribute;             // that declares it
    std::uint32_t uri;                   // a number for the namespace's name, 0 for none
    std::uint32_t shadowed;              // the binding before it in the same bucket
};

template <class Char>
class NamespaceScope
{
public:
    using View = std::basic_string_view<Char>;
    using Binding = NamespaceBinding<Char>;

    bool IsEmpty() const { return bindings.IsEmpty(); }
    std::size_t Size() const { return bindings.Size(); }
    const Binding& operator[](std::size_t index) const { return bindings[index]; }

    void Declare(View prefix, NodeIndex element, std::uint32_t attribute, std::uint32_t uri)
    {
        bindings.Append({prefix, element, attribute, uri, none});
        if (bindings.Size() > std::max(handful, buckets.Size()))
            Rehash();
        else if (IsHashed())
            Link(bindings.Size() - 1);
    }

    // Forgets what the element, the innermost with declarations, declares.
    void Leave(NodeIndex element)
    {
        while (!bindings.IsEmpty() && bindings.Back().element == element) {
            if (IsHashed())
                Bucket(bindings.Back().prefix) = bindings.Back().shadowed;
            bindings.Resize(bindings.Size() - 1);
        }
    }

    // The number of the innermost binding of a prefix, or `none`.
    std::uint32_t Find(View prefix) const { return IsHashed() ? FindByHash(prefix) : FindAmongFew(prefix); }

    static constexpr std::uint32_t none = 0xFFFFFFFF;

private:
    static constexpr std::size_t handful = 8; // as many are searched one by one

    bool IsHashed() const { return !buckets.IsEmpty(); }

    std::uint32_t FindAmongFew(View prefix) const
    {
        for (std::size_t at = bindings.Size(); at-- > 0;)
            if (bindings[at].prefix == prefix)
                return static_cast<std::uint32_t>(at);
        return none;
    }

    std::uint32_t FindByHash(View prefix) const
    {
        std::uint32_t at = buckets[BucketNumber(prefix)];
        while (at != none && bindings[at].prefix != prefix)
            at = bindings[at].shadowed;
        return at;
    }

    std::size_t BucketNumber(View prefix) const { return PlaceOf(HashOf(prefix, HashSeed()), buckets.Size()); }
    std::uint32_t& Bucket(View prefix) { return buckets[BucketNumber(prefix)]; }

    void Link(std::size_t index)
    {
        std::uint32_t& bucket = Bucket(bindings[index].prefix);
        bindings[index].shadowed = bucket;
        bucket = static_cast<std::uint32_t>(index);
    }

    void Rehash()
    {
        buckets.Fill(IsHashed() ? buckets.Size() * 2 : 2 * handful, none);
        for (std::size_t i = 0; i < bindings.Size(); ++i)
            Link(i);
    }

    PlainArray<Binding> bindings;
    PlainArray<std::uint32_t> buckets; // a power of two of them
};

} // namespace varnex3::xml
