// The encodings that a file may be in.
#pragma once

#include <cstddef>
#include <string>
#include <string_view>

#include "varnex3/xml/TextBuffer.h"

namespace varnex3::xml {

enum class Encoding
{
    Utf8,
    Utf16LittleEndian,
    Utf16BigEndian,
    Ascii,
    Latin1,
    Windows1252,
    Unknown
};

struct EncodingFacts
{
    Encoding encoding = Encoding::Utf8;
    std::size_t markLength = 0; // of the byte order mark
    std::string name;           // of an unknown one
    const char* nameAt = nullptr;
};

// From the first bytes and the XML declaration; the bytes outrank the declaration.
EncodingFacts DetectEncoding(std::string_view bytes);

// The bytes of ISO-8859-1 or windows-1252 as UTF-8. The five bytes that windows-1252 leaves open are control
// characters, as in ISO-8859-1.
TextBuffer<char> Utf8FromSingleBytes(std::string_view bytes, Encoding encoding);

// UTF-16 bytes as characters; an odd byte at the end is left out.
TextBuffer<char16_t> Utf16FromBytes(std::string_view bytes, Encoding encoding);

} // namespace varnex3::xml
