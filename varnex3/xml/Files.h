// Whole files in and out, by the path names that hosts use.
#pragma once

#include <cstddef>
#include <cstdint>
#include <string>
#include <string_view>

namespace varnex3::xml {

class Folder;

// A file name of a system whose names are bytes, as 16-bit text. Bytes that are not UTF-8 become lone surrogates
// (0xDC80 + byte - 0x80), so that NativePath gives the same name back. The names of Windows are 16-bit text already.
std::u16string FromNativePath(std::string_view native);

// The inverse of FromNativePath: what the file functions of such a system take.
std::string NativePath(std::u16string_view path);

// Whether there is a folder of that name; a link to a folder is one.
bool IsFolder(std::u16string_view path);

// A file that is being read; others may read, write, rename and delete it meanwhile. Throws std::system_error with the
// system's reason, by the numbers of <cerrno> on every system.
class InputFile
{
public:
    explicit InputFile(std::u16string_view path);
    InputFile(const Folder& folder, std::u16string_view fileName);
    ~InputFile();
    InputFile(const InputFile&) = delete;
    InputFile& operator=(const InputFile&) = delete;

    // What the system says its size is; a file may turn out to be shorter or longer.
    std::uint64_t Size() const { return size; }

    // Memory to read it into: its size and one more, so that one call meets the end. std::bad_alloc when there is no
    // such memory.
    std::size_t Room() const;

    // Reads up to `count` bytes, fewer only at the end of the file.
    std::size_t Read(char* to, std::size_t count);

private:
    void Begin(); // what follows the opening, whether that failed or not

    std::string name; // for the error
    std::intptr_t handle;
    std::uint64_t size = 0;
};

// The bytes of a file. Throws std::system_error with the system's reason (no such file, no permission, a folder).
std::string ReadFile(std::u16string_view path);

// Writes a file so that a reader, and a crash, sees either the old content or the new one: to a temporary file in
// the same folder, then renamed over the target. Throws std::system_error; the old file then stays as it was and
// nothing is left behind. On Windows a file that is marked as read-only, or that someone holds, is not replaced.
void WriteFileAtomically(std::u16string_view path, std::string_view bytes);

} // namespace varnex3::xml
