// The identifiers of the library, its classes, interfaces and enumerations: computed from their names, stored nowhere.
//
// They are version 5 (name-based) identifiers of RFC 4122 in one name space of this library's own. Hosts are bound to
// them: a name that was released keeps its identifier for ever, and docs/interface.txt shows each.
#pragma once

#include <array>
#include <cstdint>
#include <string>
#include <string_view>

#include "varnex3/server/Sha1.h"

namespace varnex3::server {

// Laid out as the GUID of Windows.
struct Guid
{
    std::uint32_t data1 = 0;
    std::uint16_t data2 = 0;
    std::uint16_t data3 = 0;
    std::array<std::uint8_t, 8> data4{};

    friend constexpr bool operator==(const Guid&, const Guid&) = default;
};

namespace guids {

// Drawn once at random. Every identifier of the library depends on it.
inline constexpr Guid kNameSpace{0x5d4fb893, 0xe5cb, 0x453e, {0xaf, 0x7a, 0x7a, 0x07, 0x76, 0x7a, 0x9f, 0x60}};

constexpr void Add(Sha1& hash, std::uint32_t number, int size)
{
    for (int shift = 8 * (size - 1); shift >= 0; shift -= 8)
        hash.Add(static_cast<std::uint8_t>(number >> shift));
}

constexpr void Add(Sha1& hash, const Guid& guid)
{
    Add(hash, guid.data1, 4);
    Add(hash, guid.data2, 2);
    Add(hash, guid.data3, 2);
    for (const std::uint8_t byte : guid.data4)
        hash.Add(byte);
}

constexpr Guid FromDigest(const Sha1::Digest& digest)
{
    const auto number = [&](std::size_t first, std::size_t size) {
        std::uint32_t value = 0;
        for (std::size_t i = first; i < first + size; ++i)
            value = value << 8 | digest[i];
        return value;
    };
    Guid guid{number(0, 4), static_cast<std::uint16_t>(number(4, 2)), static_cast<std::uint16_t>(number(6, 2)), {}};
    for (std::size_t i = 0; i < guid.data4.size(); ++i)
        guid.data4[i] = digest[8 + i];
    guid.data3 = static_cast<std::uint16_t>((guid.data3 & 0x0FFF) | 0x5000);  // version 5: by name, with SHA-1
    guid.data4[0] = static_cast<std::uint8_t>((guid.data4[0] & 0x3F) | 0x80); // the variant of RFC 4122
    return guid;
}

// The identifier of a name, given in one piece or more, in a name space.
template <class... Piece>
constexpr Guid Named(const Guid& nameSpace, Piece... pieces)
{
    Sha1 hash;
    Add(hash, nameSpace);
    (hash.Add(std::string_view(pieces)), ...);
    return FromDigest(hash.Finish());
}

} // namespace guids

// The identifier of anything of the library, by its kind and name: "class/VersionDef".
constexpr Guid GuidOf(std::string_view kindAndName) { return guids::Named(guids::kNameSpace, kindAndName); }

// Those of the type library, and of a class, its interface (the name of the class behind "_") and an enumeration.
constexpr Guid LibraryGuid() { return GuidOf("library/Varnex3"); }
constexpr Guid ClassGuid(std::string_view name) { return guids::Named(guids::kNameSpace, "class/", name); }
constexpr Guid InterfaceGuid(std::string_view name) { return guids::Named(guids::kNameSpace, "interface/_", name); }
constexpr Guid EnumerationGuid(std::string_view name) { return guids::Named(guids::kNameSpace, "enumeration/", name); }

// In capitals and without braces: "5D4FB893-E5CB-453E-AF7A-7A07767A9F60".
inline std::string ToString(const Guid& guid)
{
    std::string text;
    const auto add = [&](std::uint32_t number, int digits) {
        for (int shift = 4 * (digits - 1); shift >= 0; shift -= 4)
            text += "0123456789ABCDEF"[number >> shift & 0xF];
    };
    add(guid.data1, 8);
    add(guid.data2, 4);
    add(guid.data3, 4);
    for (const std::uint8_t byte : guid.data4)
        add(byte, 2);
    for (const std::size_t place : {20u, 16u, 12u, 8u})
        text.insert(place, "-");
    return text;
}

} // namespace varnex3::server
