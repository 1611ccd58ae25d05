// Files and folders as Windows has them.
#include <algorithm>
#include <array>
#include <atomic>
#include <cerrno>
#include <string>
#include <system_error>
#include <utility>

#include <windows.h>

#include "varnex3/xml/Folder.h"
#include "varnex3/xml/WindowsError.h"

namespace varnex3::xml {
namespace {

using Path = std::u16string;

static_assert(sizeof(wchar_t) == sizeof(char16_t)); // the system's own text is UTF-16
const wchar_t* Wide(const Path& text) { return reinterpret_cast<const wchar_t*>(text.c_str()); }
wchar_t* Wide(Path& text) { return reinterpret_cast<wchar_t*>(text.data()); }

[[noreturn]] void ThrowSystemError(int code, const std::string& name)
{
    throw std::system_error(code, std::generic_category(), name);
}

// To be called on the outcome of a system call, before another one changes the last error.
void Check(bool isDone, const std::string& name)
{
    if (!isDone)
        ThrowSystemError(ErrorNumberOf(GetLastError()), name);
}

// A name with a zero character would name another file than the one meant.
Path CheckedPath(std::u16string_view path)
{
    if (const std::size_t zero = path.find(u'\0'); zero != path.npos)
        ThrowSystemError(EINVAL, NativePath(path.substr(0, zero)));
    return Path(path);
}

bool IsSeparator(char16_t c) { return c == u'\\' || c == u'/'; }

// From the root, with backslashes, without . and ..; the path itself when the system finds nothing in it.
Path FullPath(const Path& path)
{
    const DWORD room = GetFullPathNameW(Wide(path), 0, nullptr, nullptr);
    Path full(room, u'\0');
    const DWORD length = GetFullPathNameW(Wide(path), room, Wide(full), nullptr);
    full.resize(length < room ? length : 0);
    return full.empty() ? path : full;
}

// A path as the system's functions take it. A long one needs a prefix, and is then taken literally.
Path SystemPath(const Path& path)
{
    constexpr std::size_t longestPlain = 240; // MAX_PATH less the short name that a folder must leave room for
    if (path.size() < longestPlain || path.starts_with(u"\\\\?\\") || path.starts_with(u"\\\\.\\"))
        return path;
    const Path full = FullPath(path);
    return full.starts_with(u"\\\\") ? u"\\\\?\\UNC\\" + full.substr(2) : u"\\\\?\\" + full;
}

DWORD AttributesOf(const Path& path) { return GetFileAttributesW(Wide(SystemPath(path))); }

bool IsFolderPath(const Path& path)
{
    const DWORD attributes = AttributesOf(path);
    return attributes != INVALID_FILE_ATTRIBUTES && (attributes & FILE_ATTRIBUTE_DIRECTORY) != 0;
}

// The same for the path of a file: that it is a folder's is the better reason, which the system does not give.
void CheckFile(bool isDone, const Path& path)
{
    if (isDone)
        return;
    const DWORD reason = GetLastError();
    ThrowSystemError(IsFolderPath(path) ? EISDIR : ErrorNumberOf(reason), NativePath(path));
}

// Not every system that runs programs for Windows keeps such a file from being replaced.
void CheckWritable(const Path& path)
{
    const DWORD attributes = AttributesOf(path);
    if (attributes != INVALID_FILE_ATTRIBUTES && (attributes & FILE_ATTRIBUTE_READONLY) != 0 && !IsFolderPath(path))
        ThrowSystemError(EACCES, NativePath(path));
}

HANDLE OpenForReading(const Path& path)
{
    constexpr DWORD everything = FILE_SHARE_READ | FILE_SHARE_WRITE | FILE_SHARE_DELETE;
    return CreateFileW(Wide(SystemPath(path)), GENERIC_READ, everything, nullptr, OPEN_EXISTING,
                       FILE_FLAG_SEQUENTIAL_SCAN, nullptr);
}

HANDLE HandleOf(std::intptr_t number)
{
    return reinterpret_cast<HANDLE>(number); // NOLINT(performance-no-int-to-ptr): handles are numbers
}

// How much of it one call may read or write.
DWORD Portion(std::size_t count)
{
    constexpr std::size_t most = std::size_t{1} << 30;
    return static_cast<DWORD>(std::min(count, most));
}

Path NewTemporaryPath(const Path& target)
{
    static std::atomic<unsigned> counter{0};
    const auto name =
        std::find_if(target.rbegin(), target.rend(), [](char16_t c) { return IsSeparator(c) || c == u':'; });
    const std::string number = std::to_string(GetCurrentProcessId()) + "-" + std::to_string(counter++);
    return Path(target.begin(), name.base()) + u".varnex3-" + FromNativePath(number) + u".tmp";
}

// A file beside the target that goes away again unless it takes its place.
class TemporaryFile
{
public:
    explicit TemporaryFile(const Path& targetPath)
        : target(targetPath),
          path(NewTemporaryPath(target)),
          handle(CreateFileW(Wide(SystemPath(path)), GENERIC_WRITE, 0, nullptr, CREATE_NEW, FILE_ATTRIBUTE_NORMAL,
                             nullptr))
    {
        CheckFile(handle != INVALID_HANDLE_VALUE, target);
    }
    ~TemporaryFile()
    {
        Close();
        if (!isMoved)
            DeleteFileW(Wide(SystemPath(path)));
    }
    TemporaryFile(const TemporaryFile&) = delete;
    TemporaryFile& operator=(const TemporaryFile&) = delete;

    void Write(std::string_view bytes)
    {
        while (!bytes.empty()) {
            DWORD written = 0;
            CheckFile(WriteFile(handle, bytes.data(), Portion(bytes.size()), &written, nullptr) != 0, target);
            bytes.remove_prefix(written);
        }
        CheckFile(FlushFileBuffers(handle) != 0, target);
    }

    // In one step: ReplaceFileW, which keeps more of the old file's attributes, takes two, between which there is none.
    void TakeTargetsPlace()
    {
        Close(); // what is open is not renamed
        constexpr DWORD how = MOVEFILE_REPLACE_EXISTING | MOVEFILE_WRITE_THROUGH;
        isMoved = MoveFileExW(Wide(SystemPath(path)), Wide(SystemPath(target)), how) != 0;
        CheckFile(isMoved, target);
    }

private:
    void Close()
    {
        if (handle != INVALID_HANDLE_VALUE)
            CloseHandle(std::exchange(handle, INVALID_HANDLE_VALUE));
    }

    Path target;
    Path path;
    HANDLE handle;
    bool isMoved = false;
};

// What stands in a folder, one entry at a time.
class Listing
{
public:
    explicit Listing(const Path& pattern)
        : handle(FindFirstFileExW(Wide(SystemPath(pattern)), FindExInfoBasic, &entry, FindExSearchNameMatch, nullptr,
                                  FIND_FIRST_EX_LARGE_FETCH)),
          isAtEntry(handle != INVALID_HANDLE_VALUE)
    {}
    ~Listing()
    {
        if (handle != INVALID_HANDLE_VALUE)
            FindClose(handle);
    }
    Listing(const Listing&) = delete;
    Listing& operator=(const Listing&) = delete;

    // Whether there is an entry. After the last one GetLastError says that there are no more, or another reason.
    bool IsAtEntry() const { return isAtEntry; }
    void Advance() { isAtEntry = FindNextFileW(handle, &entry) != 0; }

    bool IsFile() const { return (entry.dwFileAttributes & (FILE_ATTRIBUTE_DIRECTORY | FILE_ATTRIBUTE_DEVICE)) == 0; }
    std::u16string_view Name() const { return reinterpret_cast<const char16_t*>(entry.cFileName); }

private:
    WIN32_FIND_DATAW entry = {};
    HANDLE handle;
    bool isAtEntry;
};

// The root of a drive has no entries of its own: where it is empty its first one is not found.
bool IsEnd(DWORD reason) { return reason == ERROR_NO_MORE_FILES || reason == ERROR_FILE_NOT_FOUND; }

} // namespace

bool IsFolder(std::u16string_view path) { return path.find(u'\0') == path.npos && IsFolderPath(Path(path)); }

InputFile::InputFile(std::u16string_view path)
    : name(NativePath(path)), handle(reinterpret_cast<std::intptr_t>(OpenForReading(CheckedPath(path))))
{
    CheckFile(HandleOf(handle) != INVALID_HANDLE_VALUE, Path(path));
    Begin();
}

InputFile::InputFile(const Folder& folder, std::u16string_view fileName) : InputFile(folder.PathOf(fileName)) {}

void InputFile::Begin()
{
    LARGE_INTEGER length = {};
    if (GetFileType(HandleOf(handle)) == FILE_TYPE_DISK && GetFileSizeEx(HandleOf(handle), &length) != 0)
        size = static_cast<std::uint64_t>(length.QuadPart);
}

InputFile::~InputFile() { CloseHandle(HandleOf(handle)); }

std::size_t InputFile::Read(char* to, std::size_t count)
{
    std::size_t done = 0;
    while (done < count) {
        DWORD got = 0;
        const bool isRead = ::ReadFile(HandleOf(handle), to + done, Portion(count - done), &got, nullptr) != 0;
        Check(isRead || GetLastError() == ERROR_BROKEN_PIPE, name); // the other end of a pipe is closed: its end
        if (got == 0)
            break;
        done += got;
    }
    return done;
}

void WriteFileAtomically(std::u16string_view path, std::string_view bytes)
{
    const Path target = CheckedPath(path);
    CheckWritable(target);
    TemporaryFile temporary(target);
    temporary.Write(bytes);
    temporary.TakeTargetsPlace();
}

Folder::Folder(std::u16string_view path_) : path(CheckedPath(path_))
{
    if (!IsFolderPath(path))
        ThrowSystemError(AttributesOf(path) == INVALID_FILE_ATTRIBUTES ? ErrorNumberOf(GetLastError()) : ENOTDIR,
                         NativePath(path));
}

Folder::~Folder() = default;

std::vector<std::u16string> Folder::FileNames(const std::function<bool(std::u16string_view)>& isWanted) const
{
    std::vector<std::u16string> names;
    Listing listing(PathOf(u"*"));
    for (; listing.IsAtEntry(); listing.Advance())
        if (listing.IsFile() && isWanted(listing.Name()))
            names.emplace_back(listing.Name());
    Check(IsEnd(GetLastError()), NativePath(path));
    return names;
}

std::u16string Folder::PathOf(std::u16string_view name) const
{
    // "C:" alone is the current folder of that drive: a separator would make it the drive's root.
    const bool needsSeparator = !path.empty() && !IsSeparator(path.back()) && path.back() != u':';
    return path + (needsSeparator ? u"\\" : u"") + std::u16string(name);
}

} // namespace varnex3::xml
