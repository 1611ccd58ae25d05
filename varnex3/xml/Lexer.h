// The pieces that markup is made of: names, character data, attribute values, references. Each function takes the place
// where a piece starts and returns the place after it, or nullptr once a fault is noted. No function reads further than
// the zeros that follow the text.
#pragma once

#include <cstddef>
#include <string_view>

#include "varnex3/xml/Characters.h"
#include "varnex3/xml/Fault.h"
#include "varnex3/xml/References.h"
#include "varnex3/xml/Scan.h"

namespace varnex3::xml {

template <class Char>
class Lexer
{
public:
    using View = std::basic_string_view<Char>;

    explicit Lexer(View text) : begin(text.data()), end(text.data() + text.size()) {}

    // Notes a fault; past the end of the text it is that the text ends.
    [[gnu::cold]] std::nullptr_t Fail(ErrorCode code, const Char* at, const char* sentence, View first = {},
                                      View second = {})
    {
        const bool isAtEnd = at >= end && code != ErrorCode::NoRootElement;
        fault = {isAtEnd ? ErrorCode::UnexpectedEnd : code, isAtEnd ? end : at,
                 isAtEnd ? "The text ends where more is needed" : sentence, first, second};
        return nullptr;
    }

    bool FailFalse(ErrorCode code, const Char* at, const char* sentence, View first = {})
    {
        Fail(code, at, sentence, first);
        return false;
    }

    // The same where something else was wanted than the character found, unless no such character may be anywhere.
    [[gnu::cold]] std::nullptr_t Unexpected(ErrorCode code, const Char* at, const char* sentence)
    {
        const CodePoint point = DecodePoint(at, end);
        if (at < end && point.length == 0)
            return Fail(ErrorCode::InvalidSequence, at,
                        sizeof(Char) == 1 ? "The %c is not part of a UTF-8 sequence" : "The %c stands alone");
        if (!IsXmlCharacter(point.value))
            return Fail(ErrorCode::InvalidCharacter, at, "The %c is not allowed in XML");
        return Fail(code, at, sentence);
    }

    static bool StartsWith(const Char* p, const char* ascii)
    {
        for (; *ascii != '\0'; ++p, ++ascii)
            if (*p != static_cast<Char>(*ascii))
                return false;
        return true;
    }

    const Char* Expect(const Char* p, const char* ascii, ErrorCode code, const char* sentence)
    {
        for (; *ascii != '\0'; ++p, ++ascii)
            if (*p != static_cast<Char>(*ascii))
                return Unexpected(code, p, sentence);
        return p;
    }

    // A name of an element or attribute, with or without prefix.
    [[gnu::always_inline]] const Char* Name(const Char* p, bool& hasPrefix)
    {
        if (IsAsciiLetter(*p) || *p == '_') {
            const Char* after = SkipNameCharacters(p);
            if (Unit(*after) < 0x80 && *after != ':') {
                hasPrefix = false;
                return after;
            }
        }
        return AnyName(p, hasPrefix);
    }

    // Character data up to the next "<". It needs decoding when it has references or carriage returns.
    [[gnu::always_inline]] const Char* Text(const Char* p, bool& needsDecoding)
    {
        for (;;) {
            p = SkipPlainText(p);
            if (*p == '<')
                return p;
            p = SpecialInText(p, needsDecoding);
            if (p == nullptr)
                return nullptr;
        }
    }

    // An attribute's value up to its closing quote. It needs decoding when it has references or white space other
    // than blanks.
    const Char* Value(const Char* p, Char quote, bool& needsDecoding)
    {
        for (;;) {
            p = SkipPlainValue(p, quote);
            if (*p == quote)
                return p;
            p = SpecialInValue(p, needsDecoding);
            if (p == nullptr)
                return nullptr;
        }
    }

    // The next place of `stop`; everything before it is allowed in XML.
    const Char* Find(const Char* p, const char* stop, bool& needsDecoding)
    {
        while (p != nullptr && !StartsWith(p, stop)) {
            needsDecoding |= *p == '\r';
            p = Character(p);
        }
        return p;
    }

    const Char* Character(const Char* p)
    {
        if (Unit(*p) >= 0x20 && Unit(*p) < 0x80)
            return p + 1;
        const CodePoint point = DecodePoint(p, end);
        if (point.length == 0 || !IsXmlCharacter(point.value))
            return Unexpected(ErrorCode::InvalidCharacter, p, "");
        return p + point.length;
    }

    // The end of a name in which colons are letters; where it starts, when there is none.
    const Char* NameEnd(const Char* p) const
    {
        CodePoint point = DecodePoint(p, end);
        if (point.length == 0 || !IsNameStart(point.value))
            return p;
        while (point.length != 0 && IsNameCharacter(point.value)) {
            p += point.length;
            point = DecodePoint(p, end);
        }
        return p;
    }

    const Char* begin;
    const Char* end;
    Fault<Char> fault;

private:
    [[gnu::noinline]] const Char* AnyName(const Char* p, bool& hasPrefix)
    {
        const Char* after = NameEnd(p);
        if (after == p)
            return Unexpected(ErrorCode::InvalidName, p, "A name cannot start with %c");

        const View name(p, static_cast<std::size_t>(after - p));
        const std::size_t colon = name.find(Char{':'});
        hasPrefix = colon != View::npos;
        if (hasPrefix && !IsPrefixedName(name, colon))
            return Fail(ErrorCode::InvalidName, p, "The name '%1' is not one prefix, one colon and one name", name);
        return after;
    }

    bool IsPrefixedName(View name, std::size_t colon) const
    {
        if (colon == 0 || colon + 1 == name.size() || name.find(Char{':'}, colon + 1) != View::npos)
            return false;
        return IsNameStart(DecodePoint(name.data() + colon + 1, end).value);
    }

    [[gnu::noinline]] const Char* SpecialInText(const Char* p, bool& needsDecoding)
    {
        if (*p == '&' || *p == '\r')
            needsDecoding = true;
        if (*p == '&')
            return Reference(p);
        if (*p == ']' && p[1] == ']' && p[2] == '>')
            return Fail(ErrorCode::CDataEndInText, p, "The characters ']]>' may only end a CDATA section");
        return Character(p);
    }

    [[gnu::noinline]] const Char* SpecialInValue(const Char* p, bool& needsDecoding)
    {
        if (*p == '<')
            return Fail(ErrorCode::LessThanInAttribute, p, "A '<' is not allowed in an attribute's value");
        if (*p == '&' || IsBlank(*p))
            needsDecoding = true;
        return *p == '&' ? Reference(p) : Character(p);
    }

    const Char* Reference(const Char* p) { return p[1] == '#' ? CharacterReference(p) : EntityReference(p); }

    const Char* CharacterReference(const Char* p)
    {
        const bool isHexadecimal = p[2] == 'x';
        const Char* digits = p + (isHexadecimal ? 3 : 2);
        const Char* after = digits;
        while (IsDigit(*after) || (isHexadecimal && (Unit(*after) | 0x20) >= 'a' && (Unit(*after) | 0x20) <= 'f'))
            ++after;
        if (after == digits || *after != ';')
            return Fail(ErrorCode::InvalidReference, after < end ? p : after,
                        "A character reference is '&#', digits and a semicolon");

        const View reference(p, static_cast<std::size_t>(after + 1 - p));
        if (!IsXmlCharacter(ReadReference(reference).character))
            return Fail(ErrorCode::InvalidCharacter, p, "The reference '%1' is to a character not allowed in XML",
                        reference);
        return after + 1;
    }

    const Char* EntityReference(const Char* p)
    {
        const Char* after = NameEnd(p + 1);
        if (after == p + 1 || *after != ';')
            return Fail(ErrorCode::InvalidReference, after < end ? p : after,
                        "A '&' must start a reference that ends with a semicolon");

        const View reference(p, static_cast<std::size_t>(after + 1 - p));
        if (ReadReference(reference).character == 0)
            return Fail(ErrorCode::UndefinedEntity, p, "The entity '%1' is not defined", reference);
        return after + 1;
    }
};

} // namespace varnex3::xml
