#include "DoctorReport.h"

#include "DisplayText.h"

namespace varnex3::tool {

namespace {

UsedSetting Look(const Text& key)
{
    const SettingName name{u"corvo32", u"frmsplash", key};
    return {name, FindSetting(name)};
}

bool IsOne(const UsedSetting& setting) { return setting.found && setting.found->value == u"1"; }

// The keys that are read next depend on the first one.
std::vector<UsedSetting> UsedSettings()
{
    const UsedSetting master = Look(u"TabletUseMaster");
    const Text prefix = IsOne(master) ? u"TabletMaster" : u"";
    return {master,
            Look(prefix + u"ServerName"),
            Look(prefix + u"InstanceName"),
            Look(prefix + u"DatabaseName"),
            Look(prefix + u"SAPwd"),
            Look(u"UseNativeClient")};
}

void FindInFiles(std::vector<std::string>& findings, const std::vector<SettingsFile>& files)
{
    for (const SettingsFile& file : files)
        if (file.failure)
            findings.push_back(Printable(file.failure->Description()));
    for (const std::string& line : DamagedLines(files))
        findings.push_back(line);
}

void FindInSets(std::vector<std::string>& findings, const std::vector<ReferenceSetFacts>& sets)
{
    for (const ReferenceSetFacts& set : sets) {
        const std::string start = "The reference set " + Printable(set.name);
        if (!set.rows)
            findings.push_back(start + " cannot be had: " + Printable(set.reason));
        else if (*set.rows == 0)
            findings.push_back(start + " has no rows");
    }
}

void FindInDatabase(std::vector<std::string>& findings, const DatabaseFacts& database)
{
    if (!database.hasDriverManager)
        findings.emplace_back("There is no driver manager: install ODBC (in Debian the package unixodbc)");
    else if (!database.isDriverRegistered)
        findings.push_back("There is no driver '" + Printable(database.wantedDriver)
                           + "': register it in odbcinst.ini under that name");
    if (database.isTried && !database.isAnswering)
        findings.push_back("There is no connection to the server: " + Printable(database.reason));
    FindInSets(findings, database.referenceSets);
}

} // namespace

DoctorReport MakeReport() { return {ReadHostFacts(), ReadSettingsFiles(), UsedSettings(), CheckDatabase()}; }

std::vector<std::string> FindingsOf(const DoctorReport& report)
{
    std::vector<std::string> findings;
    FindInFiles(findings, report.files);
    FindInDatabase(findings, report.database);
    return findings;
}

} // namespace varnex3::tool
