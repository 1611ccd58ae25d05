// A path such as "Vehicle/RegistrationNo", taken apart when the library is compiled.
#pragma once

#include <cstdint>
#include <cstring>

#include "varnex3/core/Text.h"
#include "varnex3/xml/NameSet.h"

namespace varnex3 {

// The first step is the element of the section that is read, the rest leads on from there; without a rest it is the
// section itself. Blanks around the rest do not matter. Paths are literals in ASCII, and verbs take them as such.
class ElementPath
{
public:
    consteval ElementPath(const char* literal) : text(literal)
    {
        const Name path(literal);
        for (const char c : path)
            if (c < 0)
                throw "a path of characters beyond ASCII";
        const std::size_t slash = path.find('/');
        groupLength = Short(slash == Name::npos ? path.size() : slash);
        if (slash == Name::npos)
            return;
        const std::size_t last = path.find_last_not_of(' ');
        innerStart = Short(path.find_first_not_of(' ', slash + 1));
        innerLength = Short(last + 1 - innerStart);
        isDeep = Inner().find('/') != Name::npos;
        bit = xml::NameBit(Inner().substr(0, Inner().find_first_of("/ ")));
    }

    Name Group() const { return {text, groupLength}; }
    bool IsGroup() const { return innerLength == 0; }

    // What follows the group, of several steps or of one.
    constexpr Name Inner() const { return {text + innerStart, innerLength}; }
    bool IsDeep() const { return isDeep; }

    // The bit of the first step behind the group.
    std::uint8_t Bit() const { return bit; }

    // Whether the group is that one, which is a first step as well.
    bool HasGroup(Name other) const { return groupLength == other.size() && AreSame(text, other.data(), groupLength); }

    Name Whole() const { return IsGroup() ? Group() : Name(text, innerStart + std::size_t{innerLength}); }
    Name LastStep() const { return Whole().substr(Whole().rfind('/') + 1); }

private:
    // Names are compared for every value that is read: two steps for most, where a call would take longer.
    static bool AreSame(const char* a, const char* b, std::size_t length)
    {
        if (length < 4 || length > 16)
            return std::memcmp(a, b, length) == 0;
        if (length < 8)
            return AreSameEnds<std::uint32_t>(a, b, length);
        return AreSameEnds<std::uint64_t>(a, b, length);
    }

    template <class Word>
    static bool AreSameEnds(const char* a, const char* b, std::size_t length)
    {
        const std::size_t last = length - sizeof(Word);
        return ((WordAt<Word>(a) ^ WordAt<Word>(b)) | (WordAt<Word>(a + last) ^ WordAt<Word>(b + last))) == 0;
    }

    template <class Word>
    static Word WordAt(const char* p)
    {
        Word word = 0;
        std::memcpy(&word, p, sizeof(word));
        return word;
    }

    static consteval std::uint8_t Short(std::size_t length)
    {
        return length <= 255 ? static_cast<std::uint8_t>(length) : throw "a path of more than 255 characters";
    }

    const char* text;
    std::uint8_t groupLength = 0;
    std::uint8_t innerStart = 0;
    std::uint8_t innerLength = 0;
    std::uint8_t bit = 0;
    bool isDeep = false;
};

} // namespace varnex3
