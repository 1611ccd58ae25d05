// The XML declaration: <?xml version="1.0" encoding="UTF-8" standalone="yes"?>. Read once to learn the encoding of a
// file, and once to check it.
#pragma once

#include <string_view>

#include "varnex3/xml/Characters.h"
#include "varnex3/xml/Tree.h"

namespace varnex3::xml {

template <class Char>
class Declaration
{
public:
    using View = std::basic_string_view<Char>;

    // Whether a text starts with an XML declaration, well-formed or not.
    static bool StartsIn(View text)
    {
        if (!EqualsAscii(text.substr(0, 5), "<?xml"))
            return false;
        return text.size() == 5 || !IsNameCharacter(Unit(text[5])); // <?xml-stylesheet is an instruction
    }

    // Reads the declaration that a text starts with.
    explicit Declaration(View text) : rest(text.substr(5)) { Read(); }

    bool IsWellFormed() const { return sentence == nullptr; }
    View Encoding() const { return encoding; }
    DeclarationFacts Facts() const { return facts; }
    const char* Sentence() const { return sentence; } // of the fault
    const Char* After() const { return rest.data(); } // behind the declaration, or where it is not well-formed

private:
    void Read();
    bool Take(std::string_view name, View& value);
    bool TakeQuoted(View& value);
    bool SkipBlanks();
    bool Skip(std::string_view ascii);
    void Fail(const char* reason)
    {
        if (sentence == nullptr)
            sentence = reason;
    }

    static bool IsVersion(View value);
    static bool IsEncodingName(View value);

    View rest;
    View encoding;
    DeclarationFacts facts;
    const char* sentence = nullptr;
};

template <class Char>
void Declaration<Char>::Read()
{
    View version;
    View standalone;
    if (!Take("version", version) || !IsVersion(version))
        return Fail("The XML declaration must start with version=\"1.0\"");
    if (Take("encoding", encoding) && !IsEncodingName(encoding))
        return Fail("The XML declaration has an encoding that is no name");
    facts.isPresent = true;
    facts.hasStandalone = Take("standalone", standalone);
    facts.isStandalone = EqualsAscii(standalone, "yes");
    if (facts.hasStandalone && !facts.isStandalone && !EqualsAscii(standalone, "no"))
        return Fail("The XML declaration says neither standalone=\"yes\" nor \"no\"");
    SkipBlanks();
    if (sentence == nullptr && !Skip("?>"))
        Fail("The XML declaration has %c where '?>' is wanted");
}

// Takes ` name="value"` when it comes next.
template <class Char>
bool Declaration<Char>::Take(std::string_view name, View& value)
{
    const View before = rest;
    if (sentence == nullptr && SkipBlanks() && Skip(name))
        return TakeQuoted(value);
    rest = before;
    return false;
}

template <class Char>
bool Declaration<Char>::TakeQuoted(View& value)
{
    SkipBlanks();
    const bool hasEquals = Skip("=");
    SkipBlanks();
    const bool hasQuote = hasEquals && !rest.empty() && (rest[0] == '"' || rest[0] == '\'');
    const std::size_t end = hasQuote ? rest.find(rest[0], 1) : View::npos;
    if (end == View::npos) {
        Fail("The XML declaration has a value without quotes");
        return false;
    }
    value = rest.substr(1, end - 1);
    rest.remove_prefix(end + 1);
    return true;
}

template <class Char>
bool Declaration<Char>::SkipBlanks()
{
    const std::size_t before = rest.size();
    while (!rest.empty() && IsBlank(rest[0]))
        rest.remove_prefix(1);
    return rest.size() < before;
}

template <class Char>
bool Declaration<Char>::Skip(std::string_view ascii)
{
    if (!EqualsAscii(rest.substr(0, ascii.size()), ascii))
        return false;
    rest.remove_prefix(ascii.size());
    return true;
}

template <class Char>
bool Declaration<Char>::IsVersion(View value)
{
    if (value.size() < 3 || !EqualsAscii(value.substr(0, 2), "1."))
        return false;
    for (const Char c : value.substr(2))
        if (!IsDigit(c))
            return false;
    return true;
}

template <class Char>
bool Declaration<Char>::IsEncodingName(View value)
{
    if (value.empty() || !IsAsciiLetter(value[0]))
        return false;
    for (const Char c : value)
        if (!IsAsciiLetter(c) && !IsDigit(c) && c != '.' && c != '_' && c != '-')
            return false;
    return true;
}

} // namespace varnex3::xml
