// Why, and where, a text is not a well-formed document.
#pragma once

#include <cstdint>
#include <string>

namespace varnex3::xml {

// The kinds of fault the parser tells apart. The numbers are stable: hosts may store them.
enum class ErrorCode : std::int32_t
{
    None = 0,
    UnexpectedEnd = 1,      // the text ends inside an element or inside markup
    NoRootElement = 2,      // an empty text, or one with comments only
    TextOutsideRoot = 3,    // characters before or after the root element
    SecondRoot = 4,         // an element after the root element has ended
    InvalidCharacter = 5,   // a character that XML does not allow
    InvalidSequence = 6,    // bytes that are not UTF-8, a lone surrogate
    InvalidName = 7,        // no name where one is needed
    TagMismatch = 8,        // an end tag that names another element than the one open
    DuplicateAttribute = 9, // the same attribute twice, prefixes resolved
    InvalidAttribute = 10,  // no equals sign, no quotes, no blank between two attributes
    LessThanInAttribute = 11,
    InvalidReference = 12, // a bare "&", a reference without its semicolon
    UndefinedEntity = 13,  // an entity other than the five predefined ones
    CDataEndInText = 14,   // "]]>" in text
    InvalidComment = 15,   // "--" in a comment
    InvalidInstruction = 16,
    InvalidDeclaration = 17, // the XML declaration
    InvalidMarkup = 18,
    UndeclaredPrefix = 19,
    ReservedPrefix = 20, // xml or xmlns bound to, or used for, something else
    InternalSubset = 21, // a DOCTYPE with declarations of its own
    InvalidDoctype = 22,
    UnknownEncoding = 23,
    TooLarge = 24, // more than 4,294,967,295 characters
};

struct ParseError
{
    ErrorCode code = ErrorCode::None;
    std::uint32_t line = 0;   // from 1; CR LF, CR and LF each end a line
    std::uint32_t column = 0; // from 1, in characters (code points); a TAB is one
    std::u16string reason;    // one sentence without a full stop, naming what was found

    // True when there is an error.
    explicit operator bool() const { return code != ErrorCode::None; }
};

} // namespace varnex3::xml
