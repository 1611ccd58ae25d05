// The names in a parameter list, taken from its own C++ declaration when the library is compiled, so that a
// parameter is named once.
#pragma once

#include <array>

#include "varnex3/core/Interface.h"

namespace varnex3 {

// What a declaration such as `const Text& sDelimiter = u","` says beside the type.
struct Declaration
{
    Name name;
    bool isOptional = false;
    Name initial; // the text between the quotes of a default
};

namespace declarations {

constexpr bool IsIdentifier(char c)
{
    return (c >= 'a' && c <= 'z') || (c >= 'A' && c <= 'Z') || (c >= '0' && c <= '9') || c == '_';
}

// Where a character stands outside quotes; the size of the text when it does not.
constexpr std::size_t FindOutsideQuotes(Name text, char wanted)
{
    bool isQuoted = false;
    for (std::size_t i = 0; i < text.size(); ++i) {
        if (text[i] == '"')
            isQuoted = !isQuoted;
        else if (text[i] == wanted && !isQuoted)
            return i;
    }
    return text.size();
}

constexpr Name LastIdentifier(Name text)
{
    std::size_t end = text.size();
    while (end > 0 && !IsIdentifier(text[end - 1]))
        --end;
    std::size_t start = end;
    while (start > 0 && IsIdentifier(text[start - 1]))
        --start;
    return text.substr(start, end - start);
}

constexpr Name BetweenQuotes(Name text)
{
    const std::size_t open = text.find('"');
    return open == Name::npos ? Name() : text.substr(open + 1, text.rfind('"') - open - 1);
}

constexpr Declaration DeclarationIn(Name text)
{
    const std::size_t equals = FindOutsideQuotes(text, '=');
    return {LastIdentifier(text.substr(0, equals)), equals < text.size(), BetweenQuotes(text.substr(equals))};
}

} // namespace declarations

// The declarations in a parameter list as written: "(const Text& sFieldName, const Text& sValue)".
constexpr std::array<Declaration, Member::kMaxParameters> Declarations(Name list)
{
    std::array<Declaration, Member::kMaxParameters> found{};
    Name rest = list.substr(1, list.size() - 2);
    for (std::size_t i = 0; i < found.size() && !rest.empty(); ++i) {
        const std::size_t comma = declarations::FindOutsideQuotes(rest, ',');
        found[i] = declarations::DeclarationIn(rest.substr(0, comma));
        rest.remove_prefix(comma < rest.size() ? comma + 1 : comma);
    }
    return found;
}

} // namespace varnex3
