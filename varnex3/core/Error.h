// The one exception type of the library: a number, a source and a description, as automation hosts expect.
#pragma once

#include <cstdint>
#include <exception>
#include <string>

#include "varnex3/core/Text.h"

namespace varnex3 {

// The numbers that the library raises. Those below 30000 are the classic automation numbers, so that a host's error
// handling finds what it knows; those from 30000 on are the library's own.
enum class ErrorNumber : std::int32_t
{
    InvalidArgument = 5,
    Overflow = 6,
    OutOfMemory = 7,
    SubscriptOutOfRange = 9,
    TypeMismatch = 13,
    Internal = 51,
    FileNotFound = 53,
    DeviceInputOutput = 57,
    PermissionDenied = 70,
    PathFileAccess = 75,
    ObjectNotSet = 91,
    ReadOnlyProperty = 383,
    ObjectRequired = 424,
    CannotCreateObject = 429,
    NoSuchMember = 438,
    ArgumentMissing = 449,
    WrongArgumentCount = 450,
    DuplicateKey = 457,
    KeyNotFound = 32811,
    FolderMissing = 30030,
    PartNumberMissing = 30101,
};

// What went wrong: Number says which kind, Source which class and operation raised it ("SourceDef.ParseXML",
// unchanged on its way up), Description names the value and what was wanted.
class Error : public std::exception
{
public:
    Error(ErrorNumber number, Text source, Text description);

    std::int32_t Number() const noexcept { return static_cast<std::int32_t>(number); }
    const Text& Source() const noexcept { return source; }
    const Text& Description() const noexcept { return description; }

    // "SourceDef.ParseXML: TimeStamp: 'soon' is not a date (13)", as UTF-8.
    const char* what() const noexcept override { return message.c_str(); }

    // The same error, raised on behalf of an operation and about a named value: for the conversions, which know
    // neither. An error that has a source already keeps it.
    Error About(Name operation, TextView subject) const;

private:
    ErrorNumber number;
    Text source;
    Text description;
    std::string message;
};

// Raises an error of an operation, such as Raise(ErrorNumber::DuplicateKey, "InsurerDetailDef.Add", u"...").
[[noreturn]] void Raise(ErrorNumber number, Name operation, Text description);

// A value between apostrophes for a description, cut after 60 characters: 'abc'.
Text Quoted(TextView value);

// The error in flight, whatever its type, as one of the library's: for the faces, where errors leave the library.
// Memory that ended is OutOfMemory, a file that the system refuses is what its reason maps to, anything unknown is
// Internal. Precondition: called from a catch block.
Error CurrentError(Name operation);

// What the system said about a file, as an error number and words.
Error FileError(int systemError, Name operation, TextView path);

} // namespace varnex3
