#include "AppSettings.h"

#include <algorithm>

#include "DisplayText.h"
#include "varnex3/core/Error.h"
#include "varnex3/services/ModRegistry.h"

namespace varnex3::tool {

namespace {

constexpr Name kOperation = "settings set";
constexpr std::size_t kLongestMachineValue = 1023; // in bytes: what the look-up reads, less the zero byte at its end

Text KeyPath(RegistryRoot scope, TextView application, TextView section)
{
    if (scope == RegistryRoot::CurrentUser)
        return PerUserKey(application, section);
    return u"SOFTWARE\\" + Text(application) + u"\\" + Text(section);
}

// What the keys of all applications have in common, with the backslash at its end.
Text CommonPath(RegistryRoot scope)
{
    Text path = KeyPath(scope, {}, {});
    path.pop_back(); // the one between application and section
    return path;
}

bool StartsWith(TextView text, TextView start) { return EqualsIgnoringCase(text.substr(0, start.size()), start); }

bool HasIgnoringCase(TextView text, TextView part)
{
    const auto isSame = [](char16_t a, char16_t b) { return ToLower(a) == ToLower(b); };
    return std::search(text.begin(), text.end(), part.begin(), part.end(), isSame) != text.end();
}

// Nothing when the value does not belong to an application's section.
std::optional<SettingName> NameOf(const Setting& setting, TextView commonPath)
{
    if (!StartsWith(setting.key, commonPath))
        return std::nullopt;
    const TextView below = TextView(setting.key).substr(commonPath.size());
    const std::size_t end = below.find(u'\\');
    if (end == TextView::npos)
        return std::nullopt;
    return SettingName{Text(below.substr(0, end)), Text(below.substr(end + 1)), setting.name};
}

Error ErrorOf(RegistryStatus status, const Text& path)
{
    const auto error = [&](ErrorNumber number, const Text& words) {
        return Error(number, ToText(kOperation), Quoted(path) + u" cannot be written: " + words);
    };
    switch (status) {
    case RegistryStatus::AccessDenied:
        return error(ErrorNumber::PermissionDenied, u"permission denied");
    case RegistryStatus::NotFound:
        return error(ErrorNumber::PathFileAccess, u"its folder is not there and cannot be made");
    case RegistryStatus::DiskFull:
        return error(ErrorNumber::PathFileAccess, u"no space is left");
    case RegistryStatus::BadPath:
    case RegistryStatus::InvalidParameter:
        return error(ErrorNumber::InvalidArgument, u"application, section or key is a name that it cannot hold");
    default:
        return error(ErrorNumber::PathFileAccess, u"the system refuses it");
    }
}

void CheckWritable(const SettingName& name, RegistryRoot scope, TextView value)
{
    if (name.application.empty() || name.section.empty() || name.key.empty())
        Raise(ErrorNumber::InvalidArgument, kOperation, u"application, section and key must not be empty");
    if (scope == RegistryRoot::LocalMachine && ToCodePage(value).size() > kLongestMachineValue)
        Raise(ErrorNumber::InvalidArgument, kOperation, u"a machine-wide value has at most 1023 bytes");
    if (SettingsPath(scope).empty())
        Raise(ErrorNumber::PathFileAccess, kOperation, u"there is no home folder for the user's settings");
}

} // namespace

Name ScopeName(RegistryRoot scope) { return scope == RegistryRoot::LocalMachine ? "machine" : "user"; }

bool IsPassword(TextView key)
{
    constexpr TextView kEnd = u"Pwd";
    const bool endsInPwd = key.size() >= kEnd.size() && EqualsIgnoringCase(key.substr(key.size() - kEnd.size()), kEnd);
    return endsInPwd || HasIgnoringCase(key, u"Password");
}

bool IsValue(TextView key, TextView value) { return !IsPassword(key) || !value.empty(); }

std::string ShownValue(TextView key, TextView value)
{
    if (IsPassword(key))
        return value.empty() ? "not set" : "set";
    return Printable(value);
}

std::optional<FoundSetting> FindSetting(const SettingName& name)
{
    const auto& [application, section, key] = name;
    const Text machine =
        QueryRegValue(RegistryRoot::LocalMachine, KeyPath(RegistryRoot::LocalMachine, application, section), key);
    if (!machine.empty())
        return FoundSetting{RegistryRoot::LocalMachine, machine};
    // An empty user's setting is one, and outranks a default: two defaults tell it from none.
    const Text user = GetAppSetting(application, section, key, u"0", true);
    if (user != GetAppSetting(application, section, key, u"1", true))
        return std::nullopt;
    return FoundSetting{RegistryRoot::CurrentUser, user};
}

void WriteSetting(const SettingName& name, RegistryRoot scope, TextView value)
{
    CheckWritable(name, scope, value);
    Registry& registry = SystemRegistry();
    RegistryKey key{};
    RegistryStatus status = registry.Create(scope, ToCodePage(KeyPath(scope, name.application, name.section)), key);
    if (status == RegistryStatus::Done) {
        status = registry.Set(key, ToCodePage(name.key), RegistryType::Text, ToCodePage(value));
        registry.Close(key);
    }
    if (status != RegistryStatus::Done)
        throw ErrorOf(status, SettingsPath(scope));
}

std::vector<ListedSetting> SettingsOf(RegistryRoot scope, const SettingsContent& content)
{
    const Text commonPath = CommonPath(scope);
    std::vector<ListedSetting> listed;
    for (const Setting& setting : content.settings)
        if (const std::optional<SettingName> name = NameOf(setting, commonPath)) {
            const std::optional<FoundSetting> found = FindSetting(*name);
            listed.push_back({*name, scope, setting.display, found && found->scope == scope});
        }
    return listed;
}

} // namespace varnex3::tool
