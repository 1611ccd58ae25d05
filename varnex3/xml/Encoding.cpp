// Telling encodings apart, and converting those that are not Unicode.
#include "varnex3/xml/Encoding.h"

#include "varnex3/xml/Declaration.h"

namespace varnex3::xml {
namespace {

struct Signature
{
    std::string_view bytes;
    Encoding encoding;
    std::size_t markLength;
    std::string_view name = {};
};

using namespace std::string_view_literals;

// Longer ones first: the mark of UTF-16 starts that of UTF-32. The last rows are "<" without a mark.
constexpr Signature signatures[] = {
    {"\xFF\xFE\0\0"sv, Encoding::Unknown, 4, "UTF-32"},
    {"\0\0\xFE\xFF"sv, Encoding::Unknown, 4, "UTF-32"},
    {"\xEF\xBB\xBF"sv, Encoding::Utf8, 3},
    {"\xFF\xFE"sv, Encoding::Utf16LittleEndian, 2},
    {"\xFE\xFF"sv, Encoding::Utf16BigEndian, 2},
    {"<\0\0\0"sv, Encoding::Unknown, 0, "UTF-32"},
    {"\0\0\0<"sv, Encoding::Unknown, 0, "UTF-32"},
    {"<\0"sv, Encoding::Utf16LittleEndian, 0},
    {"\0<"sv, Encoding::Utf16BigEndian, 0},
    {"\x4C\x6F\xA7\x94"sv, Encoding::Unknown, 0, "EBCDIC"},
};

struct EncodingName
{
    std::string_view name;
    Encoding encoding;
};

// UTF-16 is not among them: a declaration that can be read byte by byte is not in it.
constexpr EncodingName encodingNames[] = {
    {"utf-8", Encoding::Utf8},         {"utf8", Encoding::Utf8},         {"us-ascii", Encoding::Ascii},
    {"ascii", Encoding::Ascii},        {"iso-8859-1", Encoding::Latin1}, {"iso_8859-1", Encoding::Latin1},
    {"latin1", Encoding::Latin1},      {"l1", Encoding::Latin1},         {"windows-1252", Encoding::Windows1252},
    {"cp1252", Encoding::Windows1252},
};

// What windows-1252 has from 0x80 on where ISO-8859-1 has control characters.
constexpr char16_t windows1252[32] = {0x20AC, 0x0081, 0x201A, 0x0192, 0x201E, 0x2026, 0x2020, 0x2021,
                                      0x02C6, 0x2030, 0x0160, 0x2039, 0x0152, 0x008D, 0x017D, 0x008F,
                                      0x0090, 0x2018, 0x2019, 0x201C, 0x201D, 0x2022, 0x2013, 0x2014,
                                      0x02DC, 0x2122, 0x0161, 0x203A, 0x0153, 0x009D, 0x017E, 0x0178};

std::string LowerCase(std::string_view text)
{
    std::string lower(text);
    for (char& c : lower)
        c = IsAsciiLetter(c) ? static_cast<char>(c | 0x20) : c;
    return lower;
}

EncodingFacts EncodingNamed(std::string_view name)
{
    const std::string wanted = LowerCase(name);
    for (const EncodingName& known : encodingNames)
        if (known.name == wanted)
            return {known.encoding, 0, {}, nullptr};
    return {Encoding::Unknown, 0, std::string(name), name.data()};
}

char16_t CharacterOf(char byte, Encoding encoding)
{
    const auto code = static_cast<char16_t>(Unit(byte));
    const bool isWindows = encoding == Encoding::Windows1252 && code >= 0x80 && code < 0xA0;
    return isWindows ? windows1252[code - 0x80] : code;
}

std::size_t Utf8Length(char16_t c) { return c < 0x80 ? 1 : c < 0x800 ? 2 : 3; }

} // namespace

EncodingFacts DetectEncoding(std::string_view bytes)
{
    for (const Signature& signature : signatures)
        if (bytes.substr(0, signature.bytes.size()) == signature.bytes)
            return {signature.encoding, signature.markLength, std::string(signature.name), bytes.data()};

    if (!Declaration<char>::StartsIn(bytes))
        return {};
    const Declaration<char> declaration(bytes); // one that is not well-formed is the parser's to report
    const bool isNamed = declaration.IsWellFormed() && !declaration.Encoding().empty();
    return isNamed ? EncodingNamed(declaration.Encoding()) : EncodingFacts{};
}

TextBuffer<char> Utf8FromSingleBytes(std::string_view bytes, Encoding encoding)
{
    std::size_t length = 0;
    for (const char byte : bytes)
        length += Utf8Length(CharacterOf(byte, encoding));

    TextBuffer<char> text(length);
    char* to = text.Data();
    for (const char byte : bytes)
        to = PutPoint(to, CharacterOf(byte, encoding));
    return text;
}

TextBuffer<char16_t> Utf16FromBytes(std::string_view bytes, Encoding encoding)
{
    TextBuffer<char16_t> text(bytes.size() / 2);
    const std::size_t high = encoding == Encoding::Utf16BigEndian ? 0 : 1;
    for (std::size_t i = 0; i < text.Size(); ++i)
        text.Data()[i] = static_cast<char16_t>(Unit(bytes[2 * i + high]) << 8 | Unit(bytes[2 * i + 1 - high]));
    return text;
}

} // namespace varnex3::xml
