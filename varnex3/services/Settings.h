// The files that are the registry where the system has none: where they are, what they say, what is wrong with them.
//
// /etc/varnex3/machine.reg holds HKEY_LOCAL_MACHINE, $XDG_CONFIG_HOME/varnex3/user.reg (or ~/.config/varnex3/user.reg)
// HKEY_CURRENT_USER, in the format that the registry editor of Windows exports: an exported key can be pasted in. The
// environment variable VARNEX3_SETTINGS_DIR names another folder for both. It is looked at whenever settings are read,
// but not in a program with raised privileges. On Windows there are no such files.
#pragma once

#include <cstddef>
#include <vector>

#include "varnex3/core/Text.h"
#include "varnex3/services/Registry.h"

namespace varnex3 {

// The path of a root's file, whether it is there or not; the empty text when there is no home folder.
Text SettingsPath(RegistryRoot root);

// A value that holds. `display` is u"CrvSql", u"dword:00000001", u"hex:01,02": a text as it is, other data as the file
// has them.
struct Setting
{
    Text key; // without the root
    Text name;
    Text display;
    RegistryType type;
    std::size_t line; // from 1
};

// A line that is passed over: what it says, and why that is not understood.
struct DamagedLine
{
    Text line;
    Text reason;
    std::size_t number; // from 1
};

// Both in the order of the file.
struct SettingsContent
{
    Text path;
    bool isThere = false;
    std::vector<Setting> settings;
    std::vector<DamagedLine> damagedLines;
};

// What a root's file says; one that is not there says nothing. Raises PermissionDenied (70) or another error with the
// system's reason when it is there and cannot be read.
SettingsContent ReadSettings(RegistryRoot root);

} // namespace varnex3
