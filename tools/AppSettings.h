// The settings of applications as people ask for them: by application, section and key.
#pragma once

#include <optional>
#include <string>
#include <vector>

#include "varnex3/services/Settings.h"

namespace varnex3::tool {

struct SettingName
{
    Text application;
    Text section; // may be several keys deep: u"Windows NT\\CurrentVersion"
    Text key;
};

// The value that is in force, and which of the two places it came from.
struct FoundSetting
{
    RegistryRoot scope;
    Text value;
};

struct ListedSetting
{
    SettingName name;
    RegistryRoot scope;
    Text display;   // of Setting
    bool isInForce; // not outranked by the other place, and of a kind and length that is read
};

// u"machine", u"user".
Name ScopeName(RegistryRoot scope);

// Whether the value is nobody's to see: SAPwd, TabletMasterSAPwd, whatever ends in Pwd or has Password in it, in any
// letter case.
bool IsPassword(TextView key);

// Whether such a value is one: an empty password is none.
bool IsValue(TextView key, TextView value);

// A value as it may be shown: printable, and of a password whether it is set.
std::string ShownValue(TextView key, TextView value);

// Never writes: the migration that a host's look-up may do is left out.
std::optional<FoundSetting> FindSetting(const SettingName& name);

// Writes a text, whatever the value was before. Raises what keeps it from being written.
void WriteSetting(const SettingName& name, RegistryRoot scope, TextView value);

// The settings of a file, in its order. Values elsewhere in the registry are none.
std::vector<ListedSetting> SettingsOf(RegistryRoot scope, const SettingsContent& content);

} // namespace varnex3::tool
