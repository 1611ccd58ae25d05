#include "varnex3/inbox/InboxFolder.h"

#include <algorithm>
#include <cerrno>
#include <dirent.h>
#include <fcntl.h>
#include <memory>
#include <sys/stat.h>
#include <unistd.h>
#include <utility>

#include "varnex3/core/Error.h"
#include "varnex3/xml/Files.h"

namespace varnex3 {

namespace {

constexpr Name kOperation = "Xalo_Messages.ParseFiles";

// A file descriptor that closes itself.
class Descriptor
{
public:
    explicit Descriptor(int opened) : descriptor(opened) {}
    ~Descriptor()
    {
        if (descriptor >= 0)
            close(descriptor);
    }
    Descriptor(const Descriptor&) = delete;
    Descriptor& operator=(const Descriptor&) = delete;

    int get() const { return descriptor; }
    int release() { return std::exchange(descriptor, -1); }

private:
    int descriptor;
};

struct CloseFolder
{
    void operator()(DIR* directory) const { closedir(directory); }
};

bool IsFolder(const Text& path)
{
    if (path.find(u'\0') != Text::npos) // the system would look at what stands before it
        return false;
    struct stat status
    {};
    return stat(xml::NativePath(path).c_str(), &status) == 0 && S_ISDIR(status.st_mode);
}

// The text behind the last full stop is xml.
bool HasMessageExtension(std::string_view name)
{
    constexpr std::string_view kExtension = ".xml";
    const auto isSame = [](char a, char b) { return (a >= 'A' && a <= 'Z' ? a + 32 : a) == b; };
    return name.size() >= kExtension.size()
           && std::ranges::equal(name.substr(name.size() - kExtension.size()), kExtension, isSame);
}

// A link counts as what it leads to; one that leads nowhere as a file that will not be found.
bool IsFile(int folder, const dirent& entry)
{
    if (entry.d_type == DT_REG)
        return true;
    if (entry.d_type != DT_LNK && entry.d_type != DT_UNKNOWN)
        return false;
    struct stat status
    {};
    return fstatat(folder, entry.d_name, &status, 0) != 0 || S_ISREG(status.st_mode);
}

// What the system says; a file that grows meanwhile is read whole all the same.
std::size_t SizeOf(int file)
{
    struct stat status
    {};
    return fstat(file, &status) == 0 && status.st_size > 0 ? static_cast<std::size_t>(status.st_size) : 0;
}

} // namespace

InboxFolder::InboxFolder(const Text& path_) : path(path_)
{
    if (!IsFolder(path))
        Raise(ErrorNumber::FolderMissing, kOperation, u"Folder '" + path + u"' does not exist.");
    folder = open(xml::NativePath(path).c_str(), O_RDONLY | O_DIRECTORY | O_CLOEXEC);
    if (folder < 0)
        throw FileError(errno, kOperation, path);
}

InboxFolder::~InboxFolder() { close(folder); }

std::vector<InboxFolder::File> InboxFolder::MessageFiles() const
{
    Descriptor own(dup(folder)); // closedir closes the descriptor it was given
    const std::unique_ptr<DIR, CloseFolder> directory(own.get() < 0 ? nullptr : fdopendir(own.get()));
    if (!directory)
        throw FileError(errno, kOperation, path);
    own.release();

    std::vector<File> files;
    while (true) {
        errno = 0;
        const dirent* const entry = readdir(directory.get()); // NOLINT(concurrency-mt-unsafe): the stream is ours alone
        if (!entry)
            break;
        if (HasMessageExtension(entry->d_name) && IsFile(folder, *entry))
            files.push_back({xml::FromNativePath(entry->d_name), entry->d_name});
    }
    if (errno != 0)
        throw FileError(errno, kOperation, path);
    std::ranges::sort(files, {}, &File::name);
    return files;
}

bool InboxFolder::Load(const File& file, xml::Document& document)
{
    const Descriptor opened(openat(folder, file.nativeName.c_str(), O_RDONLY | O_CLOEXEC));
    if (opened.get() < 0)
        throw FileError(errno, kOperation, PathOf(file));

    constexpr std::size_t kLeastRoom = std::size_t{1} << 16;
    const std::size_t room = std::max(kLeastRoom, SizeOf(opened.get()) + 1); // one more: to see that nothing follows
    if (bytes.size() < room)
        bytes.resize(room);
    std::size_t size = 0;
    while (true) {
        const ssize_t count = read(opened.get(), bytes.data() + size, bytes.size() - size);
        if (count < 0 && errno == EINTR)
            continue;
        if (count < 0)
            throw FileError(errno, kOperation, PathOf(file));
        if (count == 0)
            break;
        size += static_cast<std::size_t>(count);
        if (size == bytes.size())
            bytes.resize(bytes.size() * 2);
    }
    return document.LoadBytes({bytes.data(), size});
}

Text InboxFolder::PathOf(const File& file) const
{
    const bool needsSeparator = !path.empty() && path.back() != u'/';
    return path + (needsSeparator ? u"/" : u"") + file.name;
}

} // namespace varnex3
