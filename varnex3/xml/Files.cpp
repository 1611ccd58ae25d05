// Everything the engine asks of the operating system.
#include "varnex3/xml/Files.h"

#include <atomic>
#include <cerrno>
#include <cstdio>
#include <cstdlib>
#include <limits>
#include <memory>
#include <new>
#include <system_error>

#include <fcntl.h>
#include <sys/stat.h>
#include <unistd.h>

#include "varnex3/xml/Characters.h"
#include "varnex3/xml/Unicode.h"

namespace varnex3::xml {
namespace {

constexpr char16_t firstEscape = 0xDC80; // stands for the byte 0x80
constexpr char16_t lastEscape = 0xDCFF;

[[noreturn]] void ThrowSystemError(int code, const std::string& name)
{
    throw std::system_error(code, std::generic_category(), name);
}

// To be called on the outcome of a system call, before another one changes errno.
void Check(bool isDone, const std::string& name)
{
    if (!isDone)
        ThrowSystemError(errno, name);
}

// A name with a zero character would name another file than the one meant.
std::string CheckedName(std::u16string_view path)
{
    std::string name = NativePath(path);
    if (name.find('\0') != name.npos)
        ThrowSystemError(EINVAL, name.substr(0, name.find('\0')));
    return name;
}

// An open file. Its errors name the file that the caller asked for.
class FileHandle
{
public:
    FileHandle(const std::string& opened, const std::string& askedFor, int flags, mode_t mode = 0)
        : name(askedFor), number(open(opened.c_str(), flags | O_CLOEXEC, mode))
    {
        Check(number >= 0, name);
    }
    ~FileHandle() { close(number); }
    FileHandle(const FileHandle&) = delete;
    FileHandle& operator=(const FileHandle&) = delete;

    int Number() const { return number; }

    void Write(std::string_view bytes)
    {
        while (!bytes.empty()) {
            const ssize_t written = write(number, bytes.data(), bytes.size());
            Check(written >= 0 || errno == EINTR, name);
            bytes.remove_prefix(written > 0 ? static_cast<std::size_t>(written) : 0);
        }
    }

private:
    std::string name;
    int number;
};

// The file that a name leads to through symbolic links, so that a link stays one.
std::string TargetOf(const std::string& name)
{
    const std::unique_ptr<char, decltype(&std::free)> resolved(realpath(name.c_str(), nullptr), std::free);
    return resolved ? resolved.get() : name;
}

std::string FolderOf(const std::string& name)
{
    const std::size_t slash = name.rfind('/');
    return slash == name.npos ? "./" : name.substr(0, slash + 1);
}

std::string NewTemporaryName(const std::string& folder)
{
    static std::atomic<unsigned> counter{0};
    return folder + ".varnex3-" + std::to_string(getpid()) + "-" + std::to_string(counter++) + ".tmp";
}

// A file beside the target that goes away again unless it takes its place.
class TemporaryFile
{
public:
    explicit TemporaryFile(const std::string& targetFile)
        : target(targetFile),
          name(NewTemporaryName(FolderOf(target))),
          file(name, target, O_WRONLY | O_CREAT | O_EXCL, 0666)
    {}
    ~TemporaryFile()
    {
        if (!isMoved)
            unlink(name.c_str());
    }
    TemporaryFile(const TemporaryFile&) = delete;
    TemporaryFile& operator=(const TemporaryFile&) = delete;

    void TakeMode(mode_t mode) { Check(fchmod(file.Number(), mode & 07777) == 0, target); }

    void Write(std::string_view bytes)
    {
        file.Write(bytes);
        Check(fsync(file.Number()) == 0, target);
    }

    void TakeTargetsPlace()
    {
        isMoved = rename(name.c_str(), target.c_str()) == 0;
        Check(isMoved, target);
    }

private:
    std::string target;
    std::string name;
    FileHandle file;
    bool isMoved = false;
};

// So that the renaming outlives a crash too. Not every file system can; either file is whole in any case.
void SyncFolder(const std::string& folder)
{
    const int handle = open(folder.c_str(), O_RDONLY | O_DIRECTORY | O_CLOEXEC);
    if (handle < 0)
        return;
    fsync(handle);
    close(handle);
}

void Replace(const std::string& target, std::string_view bytes, const struct stat* old)
{
    TemporaryFile temporary(target);
    if (old != nullptr)
        temporary.TakeMode(old->st_mode);
    temporary.Write(bytes);
    temporary.TakeTargetsPlace();
    SyncFolder(FolderOf(target));
}

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

InputFile::InputFile(std::u16string_view path)
    : name(CheckedName(path)), handle(open(name.c_str(), O_RDONLY | O_CLOEXEC))
{
    Check(handle >= 0, name);
    struct stat facts = {};
    if (fstat(handle, &facts) == 0 && S_ISREG(facts.st_mode))
        size = static_cast<std::uint64_t>(facts.st_size);
}

InputFile::~InputFile() { close(handle); }

std::size_t InputFile::Read(char* to, std::size_t count)
{
    std::size_t done = 0;
    while (done < count) {
        const ssize_t got = read(handle, to + done, count - done);
        Check(got >= 0 || errno == EINTR, name);
        if (got == 0)
            break;
        done += got > 0 ? static_cast<std::size_t>(got) : 0;
    }
    return done;
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

void WriteFileAtomically(std::u16string_view path, std::string_view bytes)
{
    const std::string target = TargetOf(CheckedName(path));
    struct stat old = {};
    const bool isThere = stat(target.c_str(), &old) == 0;
    const bool isDevice = isThere && !S_ISREG(old.st_mode) && !S_ISDIR(old.st_mode);
    if (isDevice) // or a pipe: not to be replaced by a file
        FileHandle(target, target, O_WRONLY).Write(bytes);
    else
        Replace(target, bytes, isThere ? &old : nullptr);
}

} // namespace varnex3::xml
