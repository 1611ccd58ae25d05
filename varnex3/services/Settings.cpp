#include "varnex3/services/Settings.h"

#include <cerrno>
#include <cstdlib>
#include <string>
#include <system_error>

#include "varnex3/core/Error.h"
#include "varnex3/services/RegistryFile.h"
#include "varnex3/xml/Files.h"

namespace varnex3 {

namespace {

// A variable of the environment, unless the program has privileges that its caller has not.
std::string Variable(const char* name)
{
    const char* const value = secure_getenv(name); // NOLINT(concurrency-mt-unsafe): a host sets it before it reads
    return value != nullptr ? value : "";
}

// The folder of the user's own settings; the rules for such folders leave out what is no absolute path.
std::string UserFolder()
{
    if (const std::string folder = Variable("XDG_CONFIG_HOME"); folder.starts_with('/'))
        return folder + "/varnex3";
    const std::string home = Variable("HOME");
    return home.empty() ? "" : home + "/.config/varnex3";
}

std::string FolderOf(RegistryRoot root)
{
    if (std::string folder = Variable("VARNEX3_SETTINGS_DIR"); !folder.empty())
        return folder;
    return root == RegistryRoot::LocalMachine ? "/etc/varnex3" : UserFolder();
}

Text Display(const RegistryValue& value)
{
    std::string_view text = value.data;
    if (text.ends_with('\0'))
        text.remove_suffix(1);
    if (value.type == RegistryType::Text)
        return FromCodePage(text);
    return FromCodePage(WrittenData(value, RegistryDialect::Regedit4)); // text lists in plain bytes
}

SettingsContent ContentOf(const RegistryFile& file)
{
    SettingsContent content;
    content.isThere = true;
    for (const RegistryFile::Entry& entry : file.Entries())
        content.settings.push_back(
            {FromCodePage(entry.path), FromCodePage(entry.name), Display(entry.value), entry.value.type, entry.line});
    for (const RegistryFile::Damage& damage : file.Damages())
        content.damagedLines.push_back({FromCodePage(damage.text), FromCodePage(damage.reason), damage.line});
    return content;
}

} // namespace

Text SettingsPath(RegistryRoot root)
{
    const std::string folder = FolderOf(root);
    const bool isMachine = root == RegistryRoot::LocalMachine;
    return folder.empty() ? Text() : xml::FromNativePath(folder + (isMachine ? "/machine.reg" : "/user.reg"));
}

SettingsContent ReadSettings(RegistryRoot root)
{
    SettingsContent content;
    const Text path = SettingsPath(root);
    try {
        content = ContentOf(RegistryFile(root, xml::ReadFile(path)));
    } catch (const std::system_error& error) {
        if (error.code() != std::errc::no_such_file_or_directory)
            throw FileError(error.code().value(), "Settings.Read", path);
    }
    content.path = path;
    return content;
}

} // namespace varnex3
