#include "SettingsCommand.h"

#include <nlohmann/json.hpp>

#include "AppSettings.h"
#include "DisplayText.h"
#include "MessageFile.h"
#include "SettingsFiles.h"
#include "Table.h"
#include "ValueInput.h"
#include "varnex3/core/Error.h"

namespace varnex3::tool {

namespace {

using Json = nlohmann::ordered_json;
using Files = std::vector<SettingsFile>;

// An argument, which may be a password: it is not told when it is refused.
Text TextOf(const std::string& argument)
{
    Text text = ToUtf16(argument);
    if (ToUtf8(text) != argument)
        Raise(ErrorNumber::InvalidArgument, "settings", u"an argument is not UTF-8");
    return text;
}

SettingName NameIn(const SettingsOptions& options)
{
    return {TextOf(options.application), TextOf(options.section), TextOf(options.key)};
}

Text InWords(const SettingName& name) { return name.application + u", " + name.section + u", " + name.key; }

Json JsonOf(const SettingName& name)
{
    return {{"application", ToUtf8(name.application)}, {"section", ToUtf8(name.section)}, {"key", ToUtf8(name.key)}};
}

// A password has only whether it is set.
void AddValue(Json& json, TextView key, const Text& value)
{
    json["isSet"] = IsValue(key, value);
    if (!IsPassword(key))
        json["value"] = ToUtf8(value);
}

Status StatusFor(const Files& files) { return DamagedLines(files).empty() ? Status::Fine : Status::Findings; }

void ReportDamage(const Files& files, bool isJson, const Console& console)
{
    if (isJson)
        for (const Json& line : DamagedLinesAsJson(files))
            console.out.Line(JsonLine(line));
    else
        for (const std::string& line : DamagedLines(files))
            console.errors.Paragraph(line, 4);
}

void PrintFound(const SettingName& name, const std::optional<FoundSetting>& found, const Console& console)
{
    if (found)
        console.out.Line(ShownValue(name.key, found->value));
    else if (IsPassword(name.key))
        console.out.Line(ShownValue(name.key, {}));
    else
        console.errors.Paragraph("varnex3: " + Printable(InWords(name)) + " is not set", 4);
}

void PrintFoundAsJson(const SettingName& name, const std::optional<FoundSetting>& found, const Console& console)
{
    Json json = JsonOf(name);
    json["isSet"] = found.has_value();
    if (found) {
        json["scope"] = ScopeName(found->scope);
        AddValue(json, name.key, found->value);
    }
    console.out.Line(JsonLine(json));
}

// Whether a user's value is there in vain.
bool IsOutranked(const SettingName& name, RegistryRoot scope)
{
    const std::optional<FoundSetting> found = FindSetting(name);
    return scope == RegistryRoot::CurrentUser && found && found->scope != scope;
}

void PrintWritten(const SettingName& name, RegistryRoot scope, bool isOutranked, const Console& console)
{
    console.out.Paragraph(Printable(InWords(name)) + " is written to " + Printable(SettingsPath(scope)), 4);
    if (isOutranked)
        console.errors.Paragraph("varnex3: the machine-wide value outranks it and stays in force", 4);
}

void PrintWrittenAsJson(const SettingName& name, RegistryRoot scope, bool isOutranked, const Console& console)
{
    Json json = JsonOf(name);
    json["scope"] = ScopeName(scope);
    json["FilePath"] = ToUtf8(SettingsPath(scope));
    json["isInForce"] = !isOutranked;
    console.out.Line(JsonLine(json));
}

std::vector<ListedSetting> Collected(const Files& files, TextView application)
{
    std::vector<ListedSetting> collected;
    for (const SettingsFile& file : files)
        for (ListedSetting& setting : SettingsOf(file.scope, file.content))
            if (application.empty() || EqualsIgnoringCase(setting.name.application, application))
                collected.push_back(std::move(setting));
    return collected;
}

void PrintTable(const std::vector<ListedSetting>& settings, Terminal& terminal)
{
    Table table({{"Application", 8, 2}, {"Section", 8, 1}, {"Key", 12, 5}, {"Value", 10, 4}, {"Scope", 0, 3}});
    for (const ListedSetting& setting : settings) {
        const Style style = setting.isInForce ? Style::Plain : Style::Faint;
        const std::string scope = std::string(ScopeName(setting.scope)) + (setting.isInForce ? "" : ", unused");
        table.Add({{Printable(setting.name.application), style},
                   {Printable(setting.name.section), style},
                   {Printable(setting.name.key), style},
                   {ShownValue(setting.name.key, setting.display), style},
                   {scope, style}});
    }
    table.Print(terminal);
    terminal.Line();
}

void PrintFiles(const Files& files, Terminal& terminal)
{
    for (const SettingsFile& file : files) {
        const std::string path = file.content.path.empty() ? "no home folder" : Printable(file.content.path);
        terminal.Paragraph(
            std::string(ScopeName(file.scope)) + ": " + path + (file.content.isThere ? "" : ", not there"), 4);
    }
}

void PrintListAsJson(const std::vector<ListedSetting>& settings, Terminal& terminal)
{
    for (const ListedSetting& setting : settings) {
        Json json = JsonOf(setting.name);
        json["scope"] = ScopeName(setting.scope);
        json["isInForce"] = setting.isInForce;
        AddValue(json, setting.name.key, setting.display);
        terminal.Line(JsonLine(json));
    }
}

} // namespace

Status GetSetting(const SettingsOptions& options, const Console& console)
{
    const Files files = ReadSettingsFiles();
    RequireReadable(files);
    const SettingName name = NameIn(options);
    const std::optional<FoundSetting> found = FindSetting(name);
    if (options.isJson)
        PrintFoundAsJson(name, found, console);
    else
        PrintFound(name, found, console);
    ReportDamage(files, options.isJson, console);
    const bool isSet = found && IsValue(name.key, found->value);
    return isSet ? StatusFor(files) : Status::Findings;
}

Status SetSetting(const SettingsOptions& options, const Console& console)
{
    const SettingName name = NameIn(options);
    const RegistryRoot scope = options.isMachineWide ? RegistryRoot::LocalMachine : RegistryRoot::CurrentUser;
    const std::string value = options.value ? *options.value : ReadValue(IsPassword(name.key), console.errors);
    WriteSetting(name, scope, TextOf(value));

    const bool isOutranked = IsOutranked(name, scope);
    if (options.isJson)
        PrintWrittenAsJson(name, scope, isOutranked, console);
    else
        PrintWritten(name, scope, isOutranked, console);
    const Files files = ReadSettingsFiles();
    ReportDamage(files, options.isJson, console);
    return isOutranked ? Status::Findings : StatusFor(files);
}

Status ListSettings(const SettingsOptions& options, const Console& console)
{
    const Files files = ReadSettingsFiles();
    RequireReadable(files);
    const std::vector<ListedSetting> settings = Collected(files, TextOf(options.application));
    if (options.isJson) {
        PrintListAsJson(settings, console.out);
    } else {
        if (!settings.empty())
            PrintTable(settings, console.out);
        PrintFiles(files, console.out);
    }
    ReportDamage(files, options.isJson, console);
    return StatusFor(files);
}

} // namespace varnex3::tool
