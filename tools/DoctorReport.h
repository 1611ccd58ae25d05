// All that a report tells, gathered once; the page and the JSON are two ways to write it.
#pragma once

#include <optional>
#include <string>
#include <vector>

#include "AppSettings.h"
#include "DatabaseCheck.h"
#include "HostFacts.h"
#include "SettingsFiles.h"

namespace varnex3::tool {

// A setting that the connection depends on; without a value its default holds.
struct UsedSetting
{
    SettingName name;
    std::optional<FoundSetting> found;
};

struct DoctorReport
{
    HostFacts host;
    std::vector<SettingsFile> files;
    std::vector<UsedSetting> settings;
    DatabaseFacts database;
};

DoctorReport MakeReport();

// What is wrong, a sentence each, printable; none when everything answers.
std::vector<std::string> FindingsOf(const DoctorReport& report);

} // namespace varnex3::tool
