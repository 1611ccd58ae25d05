// A DOCTYPE: its syntax is checked, what it names is not looked at.
#pragma once

#include "varnex3/xml/Lexer.h"

namespace varnex3::xml {

template <class Char>
class Doctype
{
public:
    explicit Doctype(Lexer<Char>& noteFaultsIn) : lexer(noteFaultsIn) {}

    // From "<!DOCTYPE" to behind its ">".
    const Char* Read(const Char* p)
    {
        p = lexer.Expect(p, "<!DOCTYPE", ErrorCode::InvalidMarkup, "The %c stands where 'DOCTYPE' is wanted");
        p = ExternalId(Name(Blanks(p)));
        if (p == nullptr)
            return nullptr;
        p = SkipBlanks(p);
        if (*p == '[')
            return lexer.Fail(ErrorCode::InternalSubset, p, "The DOCTYPE has declarations of its own");
        return lexer.Expect(p, ">", ErrorCode::InvalidDoctype, "The %c stands in a DOCTYPE");
    }

private:
    // Each passes on a fault that was noted before it.
    const Char* Name(const Char* p)
    {
        bool hasPrefix = false;
        return p != nullptr ? lexer.Name(p, hasPrefix) : nullptr;
    }

    const Char* ExternalId(const Char* p)
    {
        if (p == nullptr)
            return nullptr;
        const Char* keyword = SkipBlanks(p);
        const bool isSystem = lexer.StartsWith(keyword, "SYSTEM");
        const bool isPublic = lexer.StartsWith(keyword, "PUBLIC");
        if (keyword == p || !(isSystem || isPublic))
            return p;
        p = keyword + 6;
        if (isPublic)
            p = Literal(Blanks(p), true);
        return Literal(Blanks(p), false);
    }

    const Char* Blanks(const Char* p)
    {
        if (p != nullptr && !IsBlank(*p))
            return lexer.Unexpected(ErrorCode::InvalidDoctype, p, "The %c stands where a blank is wanted");
        return p != nullptr ? SkipBlanks(p) : nullptr;
    }

    const Char* Literal(const Char* p, bool isPublic)
    {
        if (p == nullptr)
            return nullptr;
        const Char quote = *p;
        if (quote != '"' && quote != '\'')
            return lexer.Unexpected(ErrorCode::InvalidDoctype, p, "The %c stands where a quote is wanted");
        for (p = p + 1; p != nullptr && *p != quote; p = lexer.Character(p))
            if (isPublic && !IsPublicCharacter(*p))
                return lexer.Unexpected(ErrorCode::InvalidDoctype, p, "The %c is not allowed in a public identifier");
        return p != nullptr ? p + 1 : nullptr;
    }

    static bool IsPublicCharacter(Char c)
    {
        constexpr std::string_view others = " \r\n-'()+,./:=?;!*#@$_%";
        return IsAsciiLetter(c) || IsDigit(c) || (Unit(c) < 0x80 && others.find(static_cast<char>(c)) != others.npos);
    }

    Lexer<Char>& lexer;
};

} // namespace varnex3::xml
