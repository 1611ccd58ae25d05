// Files and folders as POSIX has them.
#include <atomic>
#include <cerrno>
#include <cstdio>
#include <cstdlib>
#include <memory>
#include <system_error>
#include <utility>

#include <dirent.h>
#include <fcntl.h>
#include <sys/stat.h>
#include <unistd.h>

#include "varnex3/xml/Folder.h"

namespace varnex3::xml {
namespace {

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

// A descriptor that closes itself. Its errors name the file that the caller asked for.
class Descriptor
{
public:
    Descriptor(int opened, std::string askedFor) : number(opened), name(std::move(askedFor))
    {
        Check(number >= 0, name);
    }
    ~Descriptor()
    {
        if (number >= 0)
            close(number);
    }
    Descriptor(const Descriptor&) = delete;
    Descriptor& operator=(const Descriptor&) = delete;

    int Number() const { return number; }
    int Release() { return std::exchange(number, -1); }

    void Write(std::string_view bytes)
    {
        while (!bytes.empty()) {
            const ssize_t written = write(number, bytes.data(), bytes.size());
            Check(written >= 0 || errno == EINTR, name);
            bytes.remove_prefix(written > 0 ? static_cast<std::size_t>(written) : 0);
        }
    }

private:
    int number;
    std::string name;
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
          file(open(name.c_str(), O_WRONLY | O_CREAT | O_EXCL | O_CLOEXEC, 0666), target)
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
    Descriptor file;
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

struct CloseListing
{
    void operator()(DIR* listing) const { closedir(listing); }
};
using Listing = std::unique_ptr<DIR, CloseListing>;

// Of the folder's entries, from the first one. Closing it closes its descriptor, which is one of its own.
Listing ListingOf(int folder, const std::string& name)
{
    Descriptor own(fcntl(folder, F_DUPFD_CLOEXEC, 0), name);
    Listing listing(fdopendir(own.Number()));
    Check(listing != nullptr, name);
    own.Release();
    rewinddir(listing.get()); // both descriptors have one place in the folder
    return listing;
}

bool IsFile(int folder, const dirent& entry)
{
    if (entry.d_type == DT_REG)
        return true;
    if (entry.d_type != DT_LNK && entry.d_type != DT_UNKNOWN)
        return false;
    struct stat facts = {};
    return fstatat(folder, entry.d_name, &facts, 0) != 0 || S_ISREG(facts.st_mode);
}

} // namespace

bool IsFolder(std::u16string_view path)
{
    if (path.find(u'\0') != path.npos) // the system would look at what stands before it
        return false;
    struct stat facts = {};
    return stat(NativePath(path).c_str(), &facts) == 0 && S_ISDIR(facts.st_mode);
}

InputFile::InputFile(std::u16string_view path)
    : name(CheckedName(path)), handle(open(name.c_str(), O_RDONLY | O_CLOEXEC))
{
    Begin();
}

InputFile::InputFile(const Folder& folder, std::u16string_view fileName)
    : name(CheckedName(fileName)), handle(openat(folder.handle, name.c_str(), O_RDONLY | O_CLOEXEC))
{
    Begin();
}

void InputFile::Begin()
{
    Check(handle >= 0, name);
    struct stat facts = {};
    if (fstat(static_cast<int>(handle), &facts) == 0 && S_ISREG(facts.st_mode))
        size = static_cast<std::uint64_t>(facts.st_size);
}

InputFile::~InputFile() { close(static_cast<int>(handle)); }

std::size_t InputFile::Read(char* to, std::size_t count)
{
    std::size_t done = 0;
    while (done < count) {
        const ssize_t got = read(static_cast<int>(handle), to + done, count - done);
        Check(got >= 0 || errno == EINTR, name);
        if (got == 0)
            break;
        done += got > 0 ? static_cast<std::size_t>(got) : 0;
    }
    return done;
}

void WriteFileAtomically(std::u16string_view path, std::string_view bytes)
{
    const std::string target = TargetOf(CheckedName(path));
    struct stat old = {};
    const bool isThere = stat(target.c_str(), &old) == 0;
    const bool isDevice = isThere && !S_ISREG(old.st_mode) && !S_ISDIR(old.st_mode);
    if (isDevice) // or a pipe: not to be replaced by a file
        Descriptor(open(target.c_str(), O_WRONLY | O_CLOEXEC), target).Write(bytes);
    else
        Replace(target, bytes, isThere ? &old : nullptr);
}

Folder::Folder(std::u16string_view path_)
    : path(path_), handle(open(CheckedName(path).c_str(), O_RDONLY | O_DIRECTORY | O_CLOEXEC))
{
    Check(handle >= 0, NativePath(path));
}

Folder::~Folder() { close(handle); }

std::vector<std::u16string> Folder::FileNames(const std::function<bool(std::u16string_view)>& isWanted) const
{
    const Listing listing = ListingOf(handle, NativePath(path));
    std::vector<std::u16string> names;
    while (true) {
        errno = 0;
        const dirent* const entry = readdir(listing.get()); // NOLINT(concurrency-mt-unsafe): the listing is ours alone
        if (!entry)
            break;
        std::u16string name = FromNativePath(entry->d_name);
        if (isWanted(name) && IsFile(handle, *entry))
            names.push_back(std::move(name));
    }
    Check(errno == 0, NativePath(path));
    return names;
}

std::u16string Folder::PathOf(std::u16string_view name) const
{
    const bool needsSeparator = !path.empty() && path.back() != u'/';
    return path + (needsSeparator ? u"/" : u"") + std::u16string(name);
}

} // namespace varnex3::xml
