#include "varnex3/server/Guids.h"

#include <doctest/doctest.h>

using namespace varnex3::server;

namespace {

// The name space of host names, from RFC 4122.
constexpr Guid kHostNames{0x6ba7b810, 0x9dad, 0x11d1, {0x80, 0xb4, 0x00, 0xc0, 0x4f, 0xd4, 0x30, 0xc8}};

std::string Named(std::string_view name) { return ToString(guids::Named(kHostNames, name)); }

} // namespace

// What Python's uuid.uuid5(uuid.NAMESPACE_DNS, name) gives.
TEST_CASE("An identifier is the one that every other maker of name-based identifiers gives")
{
    CHECK(Named("www.example.com") == "2ED6657D-E927-568B-95E1-2665A8AEA6A2");
    CHECK(Named("python.org") == "886313E1-3B8A-5372-9B90-0C9AEE199E5D");
    CHECK(Named(std::string(200, 'x')) == "DDCC691A-B8E2-53E5-B059-6A232874B2EB");
}

TEST_CASE("A name given by pieces has the identifier of the whole")
{
    CHECK(guids::Named(kHostNames, "www.", "example.com") == guids::Named(kHostNames, "www.example.com"));
}

TEST_CASE("Every length of a name is padded as SHA-1 wants")
{
    const auto hex = [](std::size_t length) {
        Sha1 hash;
        hash.Add(std::string(length, 'a'));
        std::string text;
        for (const std::uint8_t byte : hash.Finish())
            text += "0123456789abcdef"[byte >> 4], text += "0123456789abcdef"[byte & 15];
        return text;
    };
    CHECK(hex(0) == "da39a3ee5e6b4b0d3255bfef95601890afd80709");
    CHECK(hex(55) == "c1c8bbdc22796e28c0e15163d20899b65621d65a");
    CHECK(hex(56) == "c2db330f6083854c99d4b5bfb6e8f29f201be699");
    CHECK(hex(63) == "03f09f5b158a7a8cdad920bddc29b81c18a551f5");
    CHECK(hex(64) == "0098ba824b5c16427bd7a1122a5a442a25ec644d");
    CHECK(hex(65) == "11655326c708d70319be2610e8a57d9a5b959d3b");
    CHECK(hex(119) == "ee971065aaa017e0632a8ca6c77bb3bf8b1dfc56");
    CHECK(hex(120) == "f34c1488385346a55709ba056ddd08280dd4c6d6");
}

TEST_CASE("Identifiers are known when the library is compiled")
{
    static_assert(ClassGuid("VersionDef") == GuidOf("class/VersionDef"));
    static_assert(InterfaceGuid("VersionDef") == GuidOf("interface/_VersionDef"));
    static_assert(EnumerationGuid("CustomerTypeEnum") == GuidOf("enumeration/CustomerTypeEnum"));
    static_assert(LibraryGuid() == GuidOf("library/Varnex3"));
    static_assert(sizeof(Guid) == 16);
}

TEST_CASE("A class and its interface have identifiers of their own")
{
    CHECK_FALSE(ClassGuid("VersionDef") == InterfaceGuid("VersionDef"));
    CHECK_FALSE(ClassGuid("VersionDef") == ClassGuid("SourceDef"));
}

// Hosts are bound to these: the name space may never change.
TEST_CASE("The identifiers that hosts are bound to stay what they are")
{
    CHECK(ToString(LibraryGuid()) == "D828E957-AEED-534D-B321-53E34AFEFB3A");
    CHECK(ToString(ClassGuid("VersionDef")) == "6CD4640B-E818-5F00-AAFD-60AFBDC6EBB8");
    CHECK(ToString(InterfaceGuid("VersionDef")) == "E5E1FF21-AC4F-54E9-9954-75C3CAE45AD8");
    CHECK(ToString(EnumerationGuid("CustomerTypeEnum")) == "810D434B-DE6E-54E8-B681-16DE898A2662");
}
