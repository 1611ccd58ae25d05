// Sets of element names as one number: what is not in the set is not among the names; what is in it may be.
#pragma once

#include <cstddef>
#include <cstdint>
#include <string_view>

#include "varnex3/xml/Characters.h"

namespace varnex3::xml {

using NameSet = std::uint64_t;

inline constexpr std::size_t bitsOfNames = 64;

constexpr bool Has(NameSet names, std::uint8_t bit) { return (names >> bit & 1) != 0; }

// The bit of a name in a set, by factors that keep the names of the messages apart. An ASCII name has the same one in
// every encoding.
template <class Char>
constexpr std::uint8_t NameBit(std::basic_string_view<Char> name)
{
    if (name.empty())
        return 0;
    const auto first = std::size_t{Unit(name.front())};
    const auto last = std::size_t{Unit(name.back())};
    return static_cast<std::uint8_t>((name.size() * 9 + first * 25 + last * 30) % bitsOfNames);
}

} // namespace varnex3::xml
