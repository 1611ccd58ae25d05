#include "varnex3/inbox/InboxFolder.h"

#include <algorithm>
#include <system_error>

#include "varnex3/core/Error.h"

namespace varnex3 {

namespace {

constexpr Name kOperation = "Xalo_Messages.ParseFiles";

// The text behind the last full stop is xml.
bool HasMessageExtension(TextView name)
{
    constexpr TextView kExtension = u".xml";
    return name.size() >= kExtension.size()
           && EqualsIgnoringCase(name.substr(name.size() - kExtension.size()), kExtension);
}

// What an action gives; what the system refuses is raised as the library's error about that path.
template <class Action>
auto AboutFile(const Text& path, Action action)
{
    try {
        return action();
    } catch (const std::system_error& error) {
        throw FileError(error.code().value(), kOperation, path);
    }
}

xml::Folder Opened(const Text& path)
{
    if (!xml::IsFolder(path))
        Raise(ErrorNumber::FolderMissing, kOperation, u"Folder '" + path + u"' does not exist.");
    return AboutFile(path, [&] { return xml::Folder(path); });
}

} // namespace

InboxFolder::InboxFolder(const Text& path) : folder(Opened(path)) {}

std::vector<Text> InboxFolder::FileNames() const
{
    auto names = AboutFile(PathOf({}), [&] { return folder.FileNames(HasMessageExtension); });
    std::ranges::sort(names);
    return names;
}

bool InboxFolder::Load(const Text& name, xml::Document& document)
{
    const std::size_t size = AboutFile(PathOf(name), [&] { return Read(name); });
    return document.LoadBytes({bytes.data(), size});
}

std::size_t InboxFolder::Read(const Text& name)
{
    constexpr std::size_t kLeastRoom = std::size_t{1} << 16;
    xml::InputFile file(folder, name);
    bytes.resize(std::max({bytes.size(), kLeastRoom, file.Room()}));
    std::size_t size = file.Read(bytes.data(), bytes.size());
    while (size == bytes.size()) { // it grows
        bytes.resize(bytes.size() * 2);
        size += file.Read(bytes.data() + size, bytes.size() - size);
    }
    return size;
}

} // namespace varnex3
