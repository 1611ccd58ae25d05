// One line of a .reg file: what it says, and how a value is written.
#pragma once

#include <cstddef>
#include <string>
#include <string_view>

#include "varnex3/services/Registry.h"

namespace varnex3 {

// The two heads that a file may have. They differ in the texts that are written as bytes: those of REGEDIT4 are in the
// system's code page, those of version 5 in UTF-16.
enum class RegistryDialect
{
    Regedit4,
    Version5
};

struct RegistryValue
{
    RegistryType type = RegistryType::Text;
    std::string data; // of a text in the system's code page, with the zero byte at its end
};

// What a line says. A value that goes on over several lines is one line here, joined (RegistryFile joins them).
struct RegistryLine
{
    enum class Kind
    {
        Remark, // blank or a comment
        Head,
        Key,
        KeyDeletion,
        Value,
        ValueDeletion,
        Damaged
    };

    Kind kind = Kind::Remark;
    RegistryDialect dialect = RegistryDialect::Version5; // of a head
    std::string key;                                     // with its root, without backslashes at its end
    std::string name;                                    // of a value; empty for the default one
    RegistryValue value;
    std::size_t dataAt = 0;  // where the data of a value stand in the line
    std::string remark;      // what stands behind the key or the data: blanks, a comment
    std::string_view reason; // why the line is damaged
};

// The line is given without its line end.
RegistryLine ReadRegistryLine(std::string_view text, RegistryDialect dialect);

// Whether a line is a value in hexadecimal that goes on in the next one; whether a line can be such a next one; and
// whether that one goes on.
bool IsContinued(std::string_view text);
bool IsContinuation(std::string_view text);
bool EndsInBackslash(std::string_view text);

// ASCII letters in lower case: the form in which names are compared.
std::string FoldedName(std::string_view name);

// Whether a file can hold such a name of a key or a value: it has no line end and no zero character.
bool IsWritableName(std::string_view name);

// "name"= or @=, to be followed by the data.
std::string WrittenName(std::string_view name);

// The data of a value in one line: "text", dword:0000000a or hex(7):61,00,00.
std::string WrittenData(const RegistryValue& value, RegistryDialect dialect);

// What stands before the data and the data, bytes broken into lines of 80 characters.
std::string WrittenValue(std::string_view beforeData, const RegistryValue& value, RegistryDialect dialect,
                         std::string_view lineEnd);

} // namespace varnex3
