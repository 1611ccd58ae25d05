#include "SettingsFiles.h"

#include <nlohmann/json.hpp>

#include "DisplayText.h"

namespace varnex3::tool {

namespace {

using Json = nlohmann::ordered_json;

SettingsFile ReadSettingsFile(RegistryRoot scope)
{
    try {
        return {scope, ReadSettings(scope), {}};
    } catch (const Error& error) {
        SettingsFile file{scope, {}, error};
        file.content.path = SettingsPath(scope);
        file.content.isThere = true;
        return file;
    }
}

template <class Action>
void ForEachDamagedLine(const std::vector<SettingsFile>& files, Action action)
{
    for (const SettingsFile& file : files)
        for (const DamagedLine& line : file.content.damagedLines)
            action(file.content.path, line);
}

} // namespace

std::vector<SettingsFile> ReadSettingsFiles()
{
    return {ReadSettingsFile(RegistryRoot::LocalMachine), ReadSettingsFile(RegistryRoot::CurrentUser)};
}

void RequireReadable(const std::vector<SettingsFile>& files)
{
    for (const SettingsFile& file : files)
        if (file.failure)
            throw Error(*file.failure);
}

std::vector<std::string> DamagedLines(const std::vector<SettingsFile>& files)
{
    std::vector<std::string> lines;
    ForEachDamagedLine(files, [&](const Text& path, const DamagedLine& line) {
        lines.push_back(Printable(path) + ":" + std::to_string(line.number) + ": " + Printable(line.reason));
    });
    return lines;
}

std::vector<Json> DamagedLinesAsJson(const std::vector<SettingsFile>& files)
{
    std::vector<Json> lines;
    ForEachDamagedLine(files, [&](const Text& path, const DamagedLine& line) {
        const Json error{{"kind", "damaged"}, {"line", line.number}, {"reason", ToUtf8(line.reason)}};
        lines.push_back({{"FilePath", ToUtf8(path)}, {"error", error}});
    });
    return lines;
}

} // namespace varnex3::tool
