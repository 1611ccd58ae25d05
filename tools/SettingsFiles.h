// The two files of settings as they were found, and what is wrong with them.
#pragma once

#include <cstddef>
#include <optional>
#include <vector>

#include "Terminal.h"
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

std::size_t DamagedLineCount(const std::vector<SettingsFile>& files);

// Each damaged line as "file:line: reason". What stands in it is not told: it may be half of a password.
void PrintDamagedLines(Terminal& terminal, const std::vector<SettingsFile>& files);

// The same as an object a line: FilePath and error with kind, line and reason.
void PrintDamagedLinesAsJson(Terminal& terminal, const std::vector<SettingsFile>& files);

} // namespace varnex3::tool
