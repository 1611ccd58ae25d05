// SHA-1, fit for constant expressions: what name-based identifiers are made with. Nothing here is about secrets.
#pragma once

#include <array>
#include <bit>
#include <cstdint>
#include <string_view>

namespace varnex3::server {

// Text goes in by pieces, in order; then the digest is taken once.
class Sha1
{
public:
    static constexpr std::size_t kDigestSize = 20;
    using Digest = std::array<std::uint8_t, kDigestSize>;

    constexpr void Add(std::uint8_t byte)
    {
        const auto shift = static_cast<int>(24 - 8 * (length % 4));
        block[length / 4 % kBlockWords] |= std::uint32_t{byte} << shift;
        ++length;
        if (length % kBlockSize == 0)
            TakeBlock();
    }

    constexpr void Add(std::string_view text)
    {
        for (const char c : text)
            Add(static_cast<std::uint8_t>(c));
    }

    // The bit after the text, zeros, and the text's length in bits at the end of the last block.
    constexpr Digest Finish()
    {
        const std::uint64_t bits = 8 * length;
        Add(std::uint8_t{0x80});
        while (length % kBlockSize != kBlockSize - 8)
            Add(std::uint8_t{0});
        for (int shift = 56; shift >= 0; shift -= 8)
            Add(static_cast<std::uint8_t>(bits >> shift));
        Digest digest{};
        for (std::size_t i = 0; i < digest.size(); ++i)
            digest[i] = static_cast<std::uint8_t>(state[i / 4] >> (24 - 8 * (i % 4)));
        return digest;
    }

private:
    static constexpr std::size_t kBlockSize = 64;
    static constexpr std::size_t kBlockWords = kBlockSize / 4;
    static constexpr std::size_t kRounds = 80;

    constexpr void TakeBlock()
    {
        auto [a, b, c, d, e] = state;
        const std::array<std::uint32_t, kRounds> words = Expanded();
        for (std::size_t i = 0; i < kRounds; ++i) {
            const std::uint32_t mixed = std::rotl(a, 5) + Choice(i, b, c, d) + e + kConstants[i / 20] + words[i];
            e = d;
            d = c;
            c = std::rotl(b, 30);
            b = a;
            a = mixed;
        }
        state = {state[0] + a, state[1] + b, state[2] + c, state[3] + d, state[4] + e};
        block = {};
    }

    constexpr std::array<std::uint32_t, kRounds> Expanded() const
    {
        std::array<std::uint32_t, kRounds> words{};
        for (std::size_t i = 0; i < kRounds; ++i)
            words[i] =
                i < kBlockWords ? block[i] : std::rotl(words[i - 3] ^ words[i - 8] ^ words[i - 14] ^ words[i - 16], 1);
        return words;
    }

    static constexpr std::uint32_t Choice(std::size_t round, std::uint32_t b, std::uint32_t c, std::uint32_t d)
    {
        if (round < 20)
            return (b & c) | (~b & d);
        if (round >= 40 && round < 60)
            return (b & c) | (b & d) | (c & d);
        return b ^ c ^ d;
    }

    static constexpr std::array<std::uint32_t, 4> kConstants{0x5A827999, 0x6ED9EBA1, 0x8F1BBCDC, 0xCA62C1D6};

    std::array<std::uint32_t, 5> state{0x67452301, 0xEFCDAB89, 0x98BADCFE, 0x10325476, 0xC3D2E1F0};
    std::array<std::uint32_t, kBlockWords> block{};
    std::uint64_t length = 0;
};

} // namespace varnex3::server
