// Everything the engine asks of the operating system.
#include "varnex3/xml/Files.h"

#include <atomic>
#include <cerrno>
#include <cstdio>
#include <cstdlib>
#include <memory>
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

// A name with a zero character would name another file than the one meant.
std::string CheckedName(std::u16string_view path)
{
    std::string name = NativePath(path);
    if (name.find('\0') != name.npos)
        ThrowSystemError(EINVAL, name.substr(0, name.find('\0')));
    return name;
}

class FileHandle
{
public:
    explicit FileHandle(int handle) : number(handle) {}
    ~FileHandle() { Close(); }
    FileHandle(const FileHandle&) = delete;
    FileHandle& operator=(const FileHandle&) = delete;

    bool IsOpen() const { return number >= 0; }
    int Number() const { return number; }
    bool Close()
    {
        const int closed = number;
        number = -1;
        return closed < 0 || close(closed) == 0;
    }

private:
    int number;
};

bool WriteAll(int handle, std::string_view bytes)
{
    while (!bytes.empty()) {
        const ssize_t written = write(handle, bytes.data(), bytes.size());
        if (written < 0 && errno != EINTR)
            return false;
        bytes.remove_prefix(written > 0 ? static_cast<std::size_t>(written) : 0);
    }
    return true;
}

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

// A file that goes away again unless it takes the place of another.
class TemporaryFile
{
public:
    explicit TemporaryFile(const std::string& folder) : name(NewTemporaryName(folder)), file(Create(name)) {}
    ~TemporaryFile()
    {
        if (!isMoved && file.IsOpen())
            unlink(name.c_str());
    }

    // False, with errno, when something fails.
    bool IsCreated() const { return file.IsOpen(); }
    bool TakeModeFrom(const struct stat& other) { return fchmod(file.Number(), other.st_mode & 07777) == 0; }
    bool Write(std::string_view bytes) { return WriteAll(file.Number(), bytes) && fsync(file.Number()) == 0; }
    bool MoveTo(const std::string& target) { return isMoved = rename(name.c_str(), target.c_str()) == 0; }

private:
    static int Create(const std::string& name)
    {
        return open(name.c_str(), O_WRONLY | O_CREAT | O_EXCL | O_CLOEXEC, 0666);
    }

    std::string name;
    FileHandle file;
    bool isMoved = false;
};

bool WriteDirectly(const std::string& name, std::string_view bytes)
{
    FileHandle file(open(name.c_str(), O_WRONLY | O_CLOEXEC));
    return file.IsOpen() && WriteAll(file.Number(), bytes) && file.Close();
}

// So that the renaming outlives a crash too. Not every file system can; the file itself is safe already.
void SyncFolder(const std::string& folder)
{
    const FileHandle handle(open(folder.c_str(), O_RDONLY | O_DIRECTORY | O_CLOEXEC));
    if (handle.IsOpen())
        fsync(handle.Number());
}

bool Replace(const std::string& target, std::string_view bytes, const struct stat* old)
{
    const std::string folder = FolderOf(target);
    TemporaryFile temporary(folder);
    const bool isDone = temporary.IsCreated() && (old == nullptr || temporary.TakeModeFrom(*old))
                        && temporary.Write(bytes) && temporary.MoveTo(target);
    if (isDone)
        SyncFolder(folder);
    return isDone;
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
    if (handle < 0)
        ThrowSystemError(errno, name);
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
        if (got < 0 && errno != EINTR)
            ThrowSystemError(errno, name);
        if (got == 0)
            break;
        done += got > 0 ? static_cast<std::size_t>(got) : 0;
    }
    return done;
}

std::string ReadFile(std::u16string_view path)
{
    constexpr std::size_t step = 65536;
    InputFile file(path);
    std::string bytes(static_cast<std::size_t>(file.Size()) + 1, '\0'); // one more, to meet the end
    std::size_t length = 0;
    for (;;) {
        length += file.Read(bytes.data() + length, bytes.size() - length);
        if (length < bytes.size())
            break;
        bytes.resize(bytes.size() + bytes.size() / 2 + step);
    }
    bytes.resize(length);
    return bytes;
}

void WriteFileAtomically(std::u16string_view path, std::string_view bytes)
{
    const std::string name = CheckedName(path);
    const std::string target = TargetOf(name);
    struct stat old = {};
    const bool isThere = stat(target.c_str(), &old) == 0;
    const bool isDevice = isThere && !S_ISREG(old.st_mode) && !S_ISDIR(old.st_mode); // or a pipe: not to be replaced
    const bool isDone = isDevice ? WriteDirectly(target, bytes) : Replace(target, bytes, isThere ? &old : nullptr);
    if (!isDone)
        ThrowSystemError(errno, name);
}

} // namespace varnex3::xml
