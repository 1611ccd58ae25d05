#include "DoctorCommand.h"

#include <nlohmann/json.hpp>

#include "DoctorPage.h"
#include "DoctorReport.h"
#include "MessageFile.h"

namespace varnex3::tool {

namespace {

using Json = nlohmann::ordered_json;

Json JsonOf(const SettingsFile& file)
{
    Json json{{"scope", ScopeName(file.scope)},
              {"FilePath", ToUtf8(file.content.path)},
              {"isThere", file.content.isThere},
              {"values", file.content.settings.size()},
              {"damagedLines", Json::array()}};
    for (const DamagedLine& line : file.content.damagedLines)
        json["damagedLines"].push_back({{"line", line.number}, {"reason", ToUtf8(line.reason)}});
    if (file.failure)
        json["error"] = {{"number", file.failure->Number()}, {"reason", ToUtf8(file.failure->Description())}};
    return json;
}

Json JsonOf(const UsedSetting& setting)
{
    const auto& [name, found] = setting;
    Json json{{"key", ToUtf8(name.key)}, {"isSet", found && IsValue(name.key, found->value)}};
    if (found)
        json["scope"] = ScopeName(found->scope);
    if (found && !IsPassword(name.key))
        json["value"] = ToUtf8(found->value);
    return json;
}

Json JsonOf(const ReferenceSetFacts& set)
{
    Json json{{"name", ToUtf8(set.name)}};
    if (set.rows)
        json["rows"] = *set.rows;
    else
        json["reason"] = ToUtf8(set.reason);
    return json;
}

Json JsonOf(const Text& text) { return ToUtf8(text); }

template <class Item>
Json JsonOf(const std::vector<Item>& items)
{
    Json json = Json::array();
    for (const Item& item : items)
        json.push_back(JsonOf(item));
    return json;
}

Json ServerJson(const DatabaseFacts& database)
{
    Json json{{"isTried", database.isTried}, {"isAnswering", database.isAnswering}};
    if (database.isTried)
        json["milliseconds"] = database.duration.count();
    if (database.isAnswering)
        json["product"] = ToUtf8(database.product);
    else if (database.isTried)
        json["reason"] = ToUtf8(database.reason);
    return json;
}

Json JsonOf(const DatabaseFacts& database)
{
    return {{"hasDriverManager", database.hasDriverManager},
            {"drivers", JsonOf(database.drivers)},
            {"wantedDriver", ToUtf8(database.wantedDriver)},
            {"driver", ToUtf8(database.driver)},
            {"isDriverRegistered", database.isDriverRegistered},
            {"connectionString", ToUtf8(database.connectionString)},
            {"server", ServerJson(database)},
            {"referenceSets", JsonOf(database.referenceSets)}};
}

Json JsonOf(const DoctorReport& report)
{
    return {{"version", VARNEX3_VERSION},
            {"bits", report.host.bits},
            {"system", report.host.system},
            {"computerName", ToUtf8(report.host.computerName)},
            {"locale", {{"name", report.host.locale}, {"isInstalled", report.host.isLocaleInstalled}}},
            {"settingsFiles", JsonOf(report.files)},
            {"settings", JsonOf(report.settings)},
            {"database", JsonOf(report.database)},
            {"findings", FindingsOf(report)}};
}

} // namespace

Status Doctor(const DoctorOptions& options, const Console& console)
{
    const DoctorReport report = MakeReport();
    if (options.isJson)
        console.out.Line(JsonLine(JsonOf(report)));
    else
        PrintPage(console.out, report);
    return FindingsOf(report).empty() ? Status::Fine : Status::Findings;
}

} // namespace varnex3::tool
