// What of files is the same on every system; the rest is in FilesPosix.cpp and FilesWindows.cpp.
#include "varnex3/xml/Files.h"

#include <limits>
#include <new>

#include "varnex3/xml/Characters.h"

namespace varnex3::xml {
namespace {

constexpr char16_t firstEscape = 0xDC80; // stands for the byte 0x80
constexpr char16_t lastEscape = 0xDCFF;

} // namespace

std::u16string FromNativePath(std::string_view native)
{
    std::u16string path;
    const char* end = native.data() + native.size();
    for (const char* p = native.data(); p < end;) {
        const CodePoint point = DecodePoint(p, end);
        if (point.length != 0)
            AppendPoint(path, point.value);
        else
            path += static_cast<char16_t>(firstEscape + (Unit(*p) - 0x80));
        p += point.length != 0 ? point.length : 1;
    }
    return path;
}

std::string NativePath(std::u16string_view path)
{
    std::string native;
    const char16_t* end = path.data() + path.size();
    for (const char16_t* p = path.data(); p < end;) {
        const CodePoint point = DecodePoint(p, end);
        if (point.length == 0 && *p >= firstEscape && *p <= lastEscape)
            native += static_cast<char>(static_cast<unsigned char>(*p - firstEscape + 0x80));
        else
            AppendPoint(native, point.length != 0 ? point.value : *p);
        p += point.length != 0 ? point.length : 1;
    }
    return native;
}

std::size_t InputFile::Room() const
{
    if (size >= std::numeric_limits<std::size_t>::max())
        throw std::bad_alloc();
    return static_cast<std::size_t>(size) + 1;
}

std::string ReadFile(std::u16string_view path)
{
    InputFile file(path);
    std::string bytes(file.Room(), '\0');
    std::size_t length = file.Read(bytes.data(), bytes.size());
    while (length == bytes.size()) { // it grows, or its size is not known
        bytes.resize(bytes.size() * 2);
        length += file.Read(bytes.data() + length, bytes.size() - length);
    }
    bytes.resize(length);
    return bytes;
}

} // namespace varnex3::xml
