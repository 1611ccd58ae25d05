#include "varnex3/services/FileRegistry.h"

#include <algorithm>
#include <cerrno>
#include <ctime>
#include <new>
#include <system_error>
#include <utility>

#include "varnex3/services/FileLock.h"
#include "varnex3/services/Settings.h"
#include "varnex3/xml/Files.h"

namespace varnex3 {

namespace {

RegistryStatus StatusOf(int systemError)
{
    switch (systemError) {
    case ENOENT:
    case ENOTDIR:
        return RegistryStatus::NotFound;
    case EACCES:
    case EPERM:
    case EROFS:
        return RegistryStatus::AccessDenied;
    case ENOSPC:
    case EDQUOT:
        return RegistryStatus::DiskFull;
    default:
        return RegistryStatus::Failed;
    }
}

// What an operation came to, when it may throw.
template <class Operation>
RegistryStatus Guarded(Operation operation) noexcept
{
    try {
        return operation();
    } catch (const std::system_error& error) {
        return StatusOf(error.code().value());
    } catch (...) { // memory that ended
        return RegistryStatus::Failed;
    }
}

std::string WithoutLastBackslashes(const std::string& path) { return path.substr(0, path.find_last_not_of('\\') + 1); }

bool IsGoodPath(std::string_view path)
{
    return IsWritableName(path) && !path.starts_with('\\') && path.find("\\\\") == std::string_view::npos;
}

std::string BytesOf(const Text& path)
{
    try {
        return xml::ReadFile(path);
    } catch (const std::system_error& error) {
        if (error.code() != std::errc::no_such_file_or_directory)
            throw;
        return {};
    }
}

// The folder a file is in, with those above it. What cannot be made shows when the file is.
void MakeFolderFor(const std::string& file, mode_t mode)
{
    for (std::size_t slash = file.find('/', 1); slash != std::string::npos; slash = file.find('/', slash + 1))
        mkdir(file.substr(0, slash).c_str(), mode);
}

} // namespace

FileRegistry::FileRegistry(Locate locate_) : locate(std::move(locate_)) {}

bool FileRegistry::Stamp::operator==(const Stamp& other) const
{
    return device == other.device && number == other.number && size == other.size
           && changed.tv_sec == other.changed.tv_sec && changed.tv_nsec == other.changed.tv_nsec;
}

std::optional<FileRegistry::Stamp> FileRegistry::StampOf(const Text& path)
{
    struct stat facts = {};
    if (stat(xml::NativePath(path).c_str(), &facts) != 0)
        return std::nullopt;
    return Stamp{facts.st_dev, facts.st_ino, facts.st_size, facts.st_ctim};
}

// Whether the last change is long enough ago for the next one to show: two changes within a tick of the file system's
// clock may leave the same stamp.
bool FileRegistry::IsSettled(const Stamp& stamp)
{
    constexpr std::time_t kSeconds = 2;
    return std::time(nullptr) - stamp.changed.tv_sec > kSeconds;
}

const RegistryFile& FileRegistry::Current(RegistryRoot root)
{
    const Text path = locate(root);
    const std::optional<Stamp> stamp = StampOf(path);
    const auto known = contents.find(root);
    const bool isCurrent = known != contents.end() && known->second.path == path && known->second.stamp == stamp
                           && (!stamp || known->second.isSettled);
    if (isCurrent)
        return known->second.file;
    // The stamp is older than the bytes: a change in between shows at the next look.
    Content content{path, stamp, stamp && IsSettled(*stamp), RegistryFile(root, stamp ? BytesOf(path) : "")};
    return contents.insert_or_assign(root, std::move(content)).first->second.file;
}

// Edits what is in the file at that moment. `edit` says what came of it; the file is written when that is Done.
template <class Edit>
RegistryStatus FileRegistry::Change(RegistryRoot root, Edit edit)
{
    const Text path = locate(root);
    const std::string name = xml::NativePath(path);
    if (name.empty())
        return RegistryStatus::NotFound;
    MakeFolderFor(name, root == RegistryRoot::LocalMachine ? 0755 : 0700);
    const FileLock fileLock(name + ".lock");
    const std::string before = BytesOf(path);
    RegistryFile file(root, before);
    const RegistryStatus status = edit(file);
    const std::string after = file.Bytes();
    if (status == RegistryStatus::Done && after != before)
        xml::WriteFileAtomically(path, after);
    return status;
}

RegistryKey FileRegistry::Enter(RegistryRoot root, const std::string& path)
{
    const auto isSame = [&](const auto& open) {
        return open.second.root == root && FoldedName(open.second.path) == FoldedName(path);
    };
    auto open = std::ranges::find_if(openKeys, isSame);
    if (open == openKeys.end())
        open = openKeys.emplace(static_cast<RegistryKey>(++lastKey), OpenKey{root, path, 0}).first;
    ++open->second.count;
    return open->first;
}

RegistryStatus FileRegistry::Open(RegistryRoot root, const std::string& path, RegistryKey& key)
{
    key = RegistryKey::Invalid;
    return Guarded([&] {
        const std::lock_guard guard(mutex);
        const std::string trimmed = WithoutLastBackslashes(path);
        if (!Current(root).HasKey(trimmed))
            return IsGoodPath(trimmed) ? RegistryStatus::NotFound : RegistryStatus::BadPath;
        key = Enter(root, trimmed);
        return RegistryStatus::Done;
    });
}

RegistryStatus FileRegistry::Create(RegistryRoot root, const std::string& path, RegistryKey& key)
{
    key = RegistryKey::Invalid;
    return Guarded([&] {
        const std::lock_guard guard(mutex);
        const std::string trimmed = WithoutLastBackslashes(path);
        if (!IsGoodPath(trimmed))
            return RegistryStatus::BadPath;
        const auto create = [&](RegistryFile& file) {
            file.CreateKey(trimmed);
            return RegistryStatus::Done;
        };
        const RegistryStatus status = Current(root).HasKey(trimmed) ? RegistryStatus::Done : Change(root, create);
        if (status == RegistryStatus::Done)
            key = Enter(root, trimmed);
        return status;
    });
}

QueriedValue FileRegistry::Query(RegistryKey key, const std::string& name, std::span<char> buffer)
{
    QueriedValue queried;
    queried.status = Guarded([&] {
        const std::lock_guard guard(mutex);
        const auto open = openKeys.find(key);
        if (open == openKeys.end())
            return RegistryStatus::InvalidHandle;
        const std::optional<RegistryValue> value = Current(open->second.root).Find(open->second.path, name);
        if (!value)
            return RegistryStatus::NotFound;
        queried.type = value->type;
        queried.length = value->data.size();
        if (value->data.size() > buffer.size())
            return RegistryStatus::MoreData;
        std::ranges::copy(value->data, buffer.begin());
        return RegistryStatus::Done;
    });
    return queried;
}

RegistryStatus FileRegistry::Set(RegistryKey key, const std::string& name, RegistryType type, std::string_view data)
{
    return Guarded([&] {
        const std::lock_guard guard(mutex);
        const auto open = openKeys.find(key);
        if (open == openKeys.end())
            return RegistryStatus::InvalidHandle;
        if (!IsWritableName(name))
            return RegistryStatus::InvalidParameter;
        RegistryValue value{type, std::string(data)};
        if (type == RegistryType::Text && !data.ends_with('\0'))
            value.data += '\0';
        const std::string& path = open->second.path;
        return Change(open->second.root, [&](RegistryFile& file) {
            if (!file.HasKey(path))
                return RegistryStatus::KeyDeleted;
            file.SetValue(path, name, value);
            return RegistryStatus::Done;
        });
    });
}

RegistryStatus FileRegistry::Delete(RegistryRoot root, const std::string& path)
{
    return Guarded([&] {
        const std::lock_guard guard(mutex);
        const std::string trimmed = WithoutLastBackslashes(path);
        if (trimmed.empty())
            return RegistryStatus::AccessDenied;
        if (!Current(root).HasKey(trimmed)) // no lock, no file for that
            return RegistryStatus::NotFound;
        return Change(root, [&](RegistryFile& file) {
            if (!file.HasKey(trimmed))
                return RegistryStatus::NotFound;
            if (file.HasKeysBelow(trimmed))
                return RegistryStatus::AccessDenied;
            file.DeleteKey(trimmed);
            return RegistryStatus::Done;
        });
    });
}

RegistryStatus FileRegistry::Close(RegistryKey key)
{
    return Guarded([&] {
        const std::lock_guard guard(mutex);
        const auto open = openKeys.find(key);
        if (open == openKeys.end())
            return RegistryStatus::InvalidHandle;
        if (--open->second.count == 0)
            openKeys.erase(open);
        return RegistryStatus::Done;
    });
}

Registry& SystemRegistry()
{
    static FileRegistry registry(SettingsPath);
    return registry;
}

std::string ToCodePage(TextView text) { return ToUtf8(text); }

Text FromCodePage(std::string_view bytes) { return ToUtf16(bytes); }

} // namespace varnex3
