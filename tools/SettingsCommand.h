// varnex3 settings: reads, writes and lists the settings of applications.
#pragma once

#include <optional>
#include <string>

#include "Status.h"
#include "Terminal.h"

namespace varnex3::tool {

// Texts as the system has them.
struct SettingsOptions
{
    std::string application;
    std::string section;
    std::string key;
    std::optional<std::string> value; // read from the standard input when it is not given
    bool isForUser = false;           // the same as neither
    bool isMachineWide = false;
    bool isJson = false;
};

// A setting that is not there is a finding, and so is any damaged line of the files.
Status GetSetting(const SettingsOptions& options, const Console& console);

// Raises what keeps the value from being written. A value that is written and outranked is a finding.
Status SetSetting(const SettingsOptions& options, const Console& console);

// The settings of one application, or of all when it is empty.
Status ListSettings(const SettingsOptions& options, const Console& console);

} // namespace varnex3::tool
