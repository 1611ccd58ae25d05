// The parameters of stored procedures: what the server declares of them, and how a text becomes the value of one.
#pragma once

#include <cstdint>
#include <optional>

#include "varnex3/core/Text.h"
#include "varnex3/core/Variant.h"

namespace varnex3 {

// Declared types by the codes that classic database clients know them by.
enum class DatabaseType : std::int16_t
{
    SmallInt = 2,
    Integer = 3,
    Single = 4,
    Double = 5,
    AutomationDate = 7,
    Boolean = 11,
    Other = 12,
    TinyInt = 16,
    UnsignedTinyInt = 17,
    UnsignedSmallInt = 18,
    UnsignedInt = 19,
    BigInt = 20,
    UnsignedBigInt = 21,
    Guid = 72,
    Binary = 128,
    Char = 129,
    WChar = 130,
    Numeric = 131,
    DBDate = 133,
    DBTime = 134,
    DBTimeStamp = 135,
    VarChar = 200,
    LongVarChar = 201,
    VarWChar = 202,
    LongVarWChar = 203,
    VarBinary = 204,
    LongVarBinary = 205
};

enum class ParameterDirection : std::int16_t
{
    Input = 1,
    Output = 2,
    InputOutput = 3,
    ReturnValue = 4
};

inline constexpr std::int64_t kUnlimitedSize = 2147483647;

// The longest text that a database takes, in characters of 16 bits: 2 GB less one byte.
inline constexpr std::size_t kLongestText = (std::size_t{1} << 30) - 1;

struct ProcedureParameter
{
    Text name; // u"@ID"
    ParameterDirection direction = ParameterDirection::Input;
    DatabaseType type = DatabaseType::Other;
    std::int64_t size = 0; // of texts, in characters
    Variant value;         // Empty: none is given, or null came back
};

// The type code of what a driver declares: its own code, and its name for the type.
DatabaseType DatabaseTypeOf(std::int16_t odbcType, TextView typeName);

// The value that a text gives to a parameter of a declared type, Empty for none:
//
// | declared type                    | value                                                                        |
// |----------------------------------|------------------------------------------------------------------------------|
// | 2, 3, 16, 17, 19                 | a number as a 16-bit integer, also for 32-bit types; what is no number is 0  |
// | 20, 21                           | a number as a 32-bit integer; what is no number is 0                         |
// | 4, 5, 131                        | a number; what is none is 0                                                  |
// | 7, 133, 134, 135                 | a date; what is none gives no value                                          |
// | 11                               | a Boolean; what is none raises TypeMismatch                                  |
// | 129, 200                         | the text cut to the declared size, whole when that is unlimited              |
// | any other                        | the text                                                                     |
//
// Numbers, dates and Booleans are read as Conversions.h says. A number outside its integer type raises Overflow, and so
// does a text of more than kLongestText characters that is not cut.
Variant ConvertedText(TextView text, DatabaseType type, std::int64_t size);

} // namespace varnex3
