#include "SettingsFiles.h"

#include <nlohmann/json.hpp>

#include "DisplayText.h"
#include "MessageFile.h"

namespace varnex3::tool {

namespace {

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
            throw *file.failure;
}

std::size_t DamagedLineCount(const std::vector<SettingsFile>& files)
{
    std::size_t count = 0;
    ForEachDamagedLine(files, [&](const Text&, const DamagedLine&) { ++count; });
    return count;
}

void PrintDamagedLines(Terminal& terminal, const std::vector<SettingsFile>& files)
{
    ForEachDamagedLine(files, [&](const Text& path, const DamagedLine& line) {
        terminal.Paragraph(Printable(path) + ":" + std::to_string(line.number) + ": " + Printable(line.reason), 4);
    });
}

void PrintDamagedLinesAsJson(Terminal& terminal, const std::vector<SettingsFile>& files)
{
    ForEachDamagedLine(files, [&](const Text& path, const DamagedLine& line) {
        terminal.Line(
            JsonLine({{"FilePath", ToUtf8(path)},
                      {"error", {{"kind", "damaged"}, {"line", line.number}, {"reason", ToUtf8(line.reason)}}}}));
    });
}

} // namespace varnex3::tool
