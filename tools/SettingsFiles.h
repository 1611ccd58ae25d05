// The two files of settings as they were found, and what is wrong with them.
#pragma once

#include <nlohmann/json_fwd.hpp>
#include <optional>
#include <string>
#include <vector>

#include "varnex3/core/Error.h"
#include "varnex3/services/Settings.h"

namespace varnex3::tool {

struct SettingsFile
{
    RegistryRoot scope;
    SettingsContent content;
    std::optional<Error> failure; // it is there and cannot be read
};

// The machine's, then the user's.
std::vector<SettingsFile> ReadSettingsFiles();

// Raises the failure of the first file that cannot be read.
void RequireReadable(const std::vector<SettingsFile>& files);

// Each damaged line as "file:line: reason", printable. What stands in it is not told: it may be half of a password.
std::vector<std::string> DamagedLines(const std::vector<SettingsFile>& files);

// The same as an object each: FilePath, and error with kind, line and reason.
std::vector<nlohmann::ordered_json> DamagedLinesAsJson(const std::vector<SettingsFile>& files);

} // namespace varnex3::tool
