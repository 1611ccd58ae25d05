// The syntax of .reg files, line by line.
#include "varnex3/services/RegistryLine.h"

#include <algorithm>
#include <array>
#include <charconv>
#include <optional>
#include <system_error>

#include "varnex3/xml/Encoding.h"

namespace varnex3 {

namespace {

constexpr std::string_view kBlanks = " \t";
constexpr std::string_view kHexDigits = "0123456789abcdefABCDEF";
constexpr std::size_t kLineWidth = 80;
constexpr std::string_view kRegedit4 = "REGEDIT4";
constexpr std::string_view kVersion5 = "Windows Registry Editor Version 5.00";

constexpr Name kNotUtf8 = "the line is not UTF-8";
constexpr Name kUnknown = "neither a key in brackets, a value nor a comment";
constexpr Name kNoBracket = "the closing bracket is missing";
constexpr Name kEmptyPart = "a part of the key is empty";
constexpr Name kNoQuote = "the closing quotation mark is missing";
constexpr Name kSingleBackslash = "a backslash is to be written twice";
constexpr Name kNoEqualsSign = "the equals sign is missing";
constexpr Name kUnknownData = "the data are neither a text in quotation marks, dword: nor hex:";
constexpr Name kNotNumber32 = "dword: wants one to eight hexadecimal digits";
constexpr Name kNotBytes = "hex: wants bytes of one or two hexadecimal digits, separated by commas";
constexpr Name kNotType = "the type in brackets is no hexadecimal number";
constexpr Name kNotContinued = "the backslash at the end promises another line";
constexpr Name kRest = "something else stands behind it";

std::string_view Unblanked(std::string_view part)
{
    part.remove_prefix(std::min(part.find_first_not_of(kBlanks), part.size()));
    return part.substr(0, part.find_last_not_of(kBlanks) + 1);
}

bool IsUtf8(std::string_view text) { return ToUtf8(ToUtf16(text)) == text; }

bool IsHexadecimal(std::string_view digits, std::size_t most)
{
    return !digits.empty() && digits.size() <= most && digits.find_first_not_of(kHexDigits) == std::string_view::npos;
}

std::uint32_t HexNumber(std::string_view digits)
{
    std::uint32_t number = 0;
    std::from_chars(digits.data(), digits.data() + digits.size(), number, 16);
    return number;
}

// A number as hexadecimal digits, zeros before it.
std::string HexDigits(std::uint32_t number, std::size_t width)
{
    std::array<char, 8> digits{};
    const auto end = std::to_chars(digits.begin(), digits.end(), number, 16).ptr;
    const auto count = static_cast<std::size_t>(end - digits.begin());
    return std::string(width > count ? width - count : 0, '0') + std::string(digits.data(), count);
}

// The four bytes of a 32-bit number, lowest first.
std::string Number32Data(std::uint32_t number)
{
    std::string data;
    for (int i = 0; i < 4; ++i, number >>= 8)
        data += static_cast<char>(number & 0xFF);
    return data;
}

std::uint32_t Number32From(std::string_view data)
{
    std::uint32_t number = 0;
    for (std::size_t i = data.size(); i-- > 0;)
        number = number << 8 | static_cast<unsigned char>(data[i]);
    return number;
}

bool IsTextType(RegistryType type)
{
    return type == RegistryType::Text || type == RegistryType::ExpandableText || type == RegistryType::TextList;
}

bool HasWideBytes(RegistryType type, RegistryDialect dialect)
{
    return dialect == RegistryDialect::Version5 && IsTextType(type);
}

std::string FromWideBytes(std::string_view bytes)
{
    return ToUtf8(xml::Utf16FromBytes(bytes, xml::Encoding::Utf16LittleEndian).View());
}

std::string ToWideBytes(std::string_view data)
{
    std::string bytes;
    for (const char16_t unit : ToUtf16(data)) {
        bytes += static_cast<char>(unit & 0xFF);
        bytes += static_cast<char>(unit >> 8);
    }
    return bytes;
}

// What is wrong with a line.
struct Fault
{
    Name reason;
};

// Reads a line from left to right, up to the first fault, which it throws.
class LineReader
{
public:
    LineReader(std::string_view text_, RegistryDialect dialect_) : text(text_), dialect(dialect_) {}

    RegistryLine Read()
    {
        if (!IsUtf8(text))
            throw Fault{kNotUtf8};
        SkipBlanks();
        if (IsAtRemark() || TakeHead())
            return line;
        if (Take("["))
            ReadKey();
        else if (Next() == '"' || Next() == '@')
            ReadValue();
        else
            throw Fault{kUnknown};
        return line;
    }

private:
    std::string_view Rest() const { return text.substr(at); }
    char Next() const { return at < text.size() ? text[at] : '\0'; }
    bool IsAtRemark() const { return at == text.size() || text[at] == ';'; }

    bool TakeHead()
    {
        const std::string_view head = Unblanked(Rest());
        if (head != kRegedit4 && head != kVersion5)
            return false;
        line.kind = RegistryLine::Kind::Head;
        line.dialect = head == kVersion5 ? RegistryDialect::Version5 : RegistryDialect::Regedit4;
        return true;
    }

    void SkipBlanks() { at = std::min(text.find_first_not_of(kBlanks, at), text.size()); }

    bool Take(std::string_view word)
    {
        const bool isNext = FoldedName(Rest().substr(0, word.size())) == word;
        at += isNext ? word.size() : 0;
        return isNext;
    }

    // The brackets end with the last one: a name may hold others.
    void ReadKey()
    {
        line.kind = Take("-") ? RegistryLine::Kind::KeyDeletion : RegistryLine::Kind::Key;
        const std::size_t end = text.rfind(']');
        if (end == std::string_view::npos || end < at)
            throw Fault{kNoBracket};
        line.key = text.substr(at, end - at);
        line.key.erase(line.key.find_last_not_of('\\') + 1);
        if (line.key.empty() || line.key.front() == '\\' || line.key.find("\\\\") != std::string::npos)
            throw Fault{kEmptyPart};
        at = end + 1;
        ReadRemark();
    }

    void ReadValue()
    {
        line.kind = RegistryLine::Kind::Value;
        if (!Take("@"))
            line.name = ReadText();
        SkipBlanks();
        if (!Take("="))
            throw Fault{kNoEqualsSign};
        SkipBlanks();
        line.dataAt = at;
        ReadData();
        ReadRemark();
    }

    void ReadData()
    {
        if (Take("-"))
            line.kind = RegistryLine::Kind::ValueDeletion;
        else if (Next() == '"')
            line.value = {RegistryType::Text, ReadText() + '\0'};
        else if (Take("dword:"))
            line.value = {RegistryType::Number32, ReadNumber32()};
        else if (Take("hex"))
            ReadBytes();
        else
            throw Fault{kUnknownData};
    }

    // A text in quotation marks.
    std::string ReadText()
    {
        std::string plain;
        for (++at; at < text.size() && text[at] != '"'; ++at) {
            if (text[at] == '\\' && ++at < text.size() && text[at] != '\\' && text[at] != '"')
                throw Fault{kSingleBackslash};
            plain += at < text.size() ? text.substr(at, 1) : "";
        }
        if (at >= text.size())
            throw Fault{kNoQuote};
        ++at;
        return plain;
    }

    // What stands before a comment or the end.
    std::string_view TakeWord()
    {
        SkipBlanks();
        const std::string_view word = Rest().substr(0, Rest().find(';'));
        const std::size_t length = word.find_last_not_of(kBlanks) + 1;
        at += length;
        return word.substr(0, length);
    }

    std::string ReadNumber32()
    {
        const std::string_view digits = TakeWord();
        if (!IsHexadecimal(digits, 8))
            throw Fault{kNotNumber32};
        return Number32Data(HexNumber(digits));
    }

    void ReadBytes()
    {
        line.value.type = Take("(") ? ReadType() : RegistryType::Binary;
        if (!Take(":"))
            throw Fault{kUnknownData};
        const std::string bytes = BytesFrom(TakeWord());
        line.value.data = HasWideBytes(line.value.type, dialect) ? FromWideBytes(bytes) : bytes;
    }

    RegistryType ReadType()
    {
        const std::string_view digits = Rest().substr(0, Rest().find(')'));
        if (!IsHexadecimal(digits, 8))
            throw Fault{kNotType};
        at += digits.size();
        if (!Take(")"))
            throw Fault{kNotType};
        return static_cast<RegistryType>(HexNumber(digits));
    }

    static std::string BytesFrom(std::string_view list)
    {
        std::string bytes;
        while (!list.empty()) {
            const std::size_t comma = std::min(list.find(','), list.size());
            const std::string_view digits = Unblanked(list.substr(0, comma));
            if (digits == "\\")
                throw Fault{kNotContinued};
            if (!IsHexadecimal(digits, 2) || comma + 1 == list.size())
                throw Fault{kNotBytes};
            bytes += static_cast<char>(HexNumber(digits));
            list.remove_prefix(std::min(comma + 1, list.size()));
        }
        return bytes;
    }

    void ReadRemark()
    {
        line.remark = Rest();
        SkipBlanks();
        if (!IsAtRemark())
            throw Fault{kRest};
    }

    std::string_view text;
    RegistryDialect dialect;
    std::size_t at = 0;
    RegistryLine line;
};

std::string Escaped(std::string_view text)
{
    std::string escaped;
    for (const char c : text) {
        if (c == '\\' || c == '"')
            escaped += '\\';
        escaped += c;
    }
    return escaped;
}

// The text between quotation marks, when the data are a text that can stand there.
std::optional<std::string_view> QuotableText(const RegistryValue& value)
{
    std::string_view text = value.data;
    if (!text.empty() && text.back() == '\0')
        text.remove_suffix(1);
    const bool isQuotable = value.type == RegistryType::Text && IsWritableName(text) && IsUtf8(text);
    return isQuotable ? std::optional(text) : std::nullopt;
}

std::string WrittenType(RegistryType type)
{
    return type == RegistryType::Binary ? "hex:" : "hex(" + HexDigits(static_cast<std::uint32_t>(type), 1) + "):";
}

} // namespace

RegistryLine ReadRegistryLine(std::string_view text, RegistryDialect dialect)
{
    try {
        return LineReader(text, dialect).Read();
    } catch (const Fault& fault) {
        RegistryLine damaged;
        damaged.kind = RegistryLine::Kind::Damaged;
        damaged.reason = fault.reason;
        return damaged;
    }
}

bool IsContinued(std::string_view text)
{
    const std::string folded = FoldedName(Unblanked(text));
    const bool isValue = folded.starts_with('"') || folded.starts_with('@');
    return isValue && folded.ends_with('\\') && folded.find("hex", folded.find('=')) != std::string::npos;
}

bool IsContinuation(std::string_view text)
{
    const std::string_view bytes = Unblanked(text.substr(0, text.find(';')));
    return !bytes.empty() && bytes.find_first_not_of("0123456789abcdefABCDEF, \t\\") == std::string_view::npos;
}

bool EndsInBackslash(std::string_view text) { return Unblanked(text).ends_with('\\'); }

std::string FoldedName(std::string_view name)
{
    std::string folded(name);
    std::ranges::transform(folded, folded.begin(),
                           [](char c) { return c >= 'A' && c <= 'Z' ? static_cast<char>(c + 32) : c; });
    return folded;
}

bool IsWritableName(std::string_view name)
{
    return name.find_first_of(std::string_view("\0\r\n", 3)) == std::string_view::npos;
}

std::string WrittenName(std::string_view name) { return name.empty() ? "@=" : "\"" + Escaped(name) + "\"="; }

std::string WrittenData(const RegistryValue& value, RegistryDialect dialect)
{
    if (const std::optional<std::string_view> text = QuotableText(value))
        return "\"" + Escaped(*text) + "\"";
    if (value.type == RegistryType::Number32 && value.data.size() == 4)
        return "dword:" + HexDigits(Number32From(value.data), 8);

    std::string written = WrittenType(value.type);
    for (const char byte : HasWideBytes(value.type, dialect) ? ToWideBytes(value.data) : value.data)
        written += HexDigits(static_cast<unsigned char>(byte), 2) + ",";
    if (written.back() == ',')
        written.pop_back();
    return written;
}

std::string WrittenValue(std::string_view beforeData, const RegistryValue& value, RegistryDialect dialect,
                         std::string_view lineEnd)
{
    std::string written(beforeData);
    const std::string data = WrittenData(value, dialect);
    if (!data.starts_with("hex"))
        return written + data;

    std::size_t column = written.size();
    for (std::string_view rest = data; !rest.empty();) {
        const std::string_view part = rest.substr(0, rest.find(',')); // "hex:01" or "01"
        const std::string_view withComma = rest.substr(0, part.size() + 1);
        if (column + withComma.size() + 1 > kLineWidth && column > 2) { // room for the backslash
            written += "\\" + std::string(lineEnd) + "  ";
            column = 2;
        }
        written += withComma;
        column += withComma.size();
        rest.remove_prefix(withComma.size());
    }
    return written;
}

} // namespace varnex3
