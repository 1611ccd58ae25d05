#include "DoctorPage.h"

#include <algorithm>
#include <array>
#include <charconv>

#include "DisplayText.h"
#include "RecordTree.h"

namespace varnex3::tool {

namespace {

void PrintHeading(Terminal& terminal, std::string_view title)
{
    terminal.Line();
    terminal.Line(terminal.Styled(Style::Heading, title));
}

std::string InWords(Milliseconds duration)
{
    std::array<char, 32> digits{};
    const auto end = std::to_chars(digits.begin(), digits.end(), duration.count(), std::chars_format::fixed, 1);
    return std::string(digits.begin(), end.ptr) + " ms";
}

void PrintHost(Terminal& terminal, const HostFacts& host)
{
    terminal.Line(terminal.Styled(Style::Heading, "varnex3 " VARNEX3_VERSION));
    PrintField(terminal, 1, "Program", std::to_string(host.bits) + " bits");
    PrintField(terminal, 1, "System", host.system);
    PrintField(terminal, 1, "Computer name", Printable(host.computerName));
    PrintField(terminal, 1, "Locale", host.locale + (host.isLocaleInstalled ? "" : ", not installed: C is in force"));
}

std::string InWords(const SettingsFile& file)
{
    if (file.content.path.empty())
        return "no home folder";
    const std::string path = Printable(file.content.path);
    if (file.failure)
        return path + ", cannot be read";
    return path + (file.content.isThere ? ", " + Plural(file.content.settings.size(), "value") : ", not there");
}

std::string InWords(const UsedSetting& setting)
{
    if (!setting.found)
        return "not set";
    return ShownValue(setting.name.key, setting.found->value) + " (" + std::string(ScopeName(setting.found->scope))
           + ")";
}

void PrintSettings(Terminal& terminal, const DoctorReport& report)
{
    PrintHeading(terminal, "Settings");
    for (const SettingsFile& file : report.files)
        PrintField(terminal, 1, file.scope == RegistryRoot::CurrentUser ? "The user's" : "Machine-wide", InWords(file));
    for (const UsedSetting& setting : report.settings)
        PrintField(terminal, 1, Printable(setting.name.key), InWords(setting));
}

std::string InWords(const std::vector<Text>& drivers)
{
    std::string words;
    for (const Text& driver : drivers)
        words += (words.empty() ? "" : ", ") + Printable(driver);
    return words.empty() ? "none" : words;
}

std::string DriverInWords(const DatabaseFacts& database)
{
    if (!database.isDriverRegistered)
        return Printable(database.wantedDriver) + ", not registered";
    const bool isAnother = !EqualsIgnoringCase(database.driver, database.wantedDriver);
    return Printable(database.driver) + (isAnother ? " in the place of " + Printable(database.wantedDriver) : "");
}

std::string ServerInWords(const DatabaseFacts& database)
{
    if (!database.isTried)
        return "not tried";
    const std::string time = InWords(database.duration);
    if (!database.isAnswering)
        return "no connection, " + time; // the reason is a finding
    return "answers, " + time + (database.product.empty() ? "" : ": " + Printable(database.product));
}

// Broken behind semicolons, so that a part can be read at a glance.
void PrintConnectionString(Terminal& terminal, const Text& connectionString)
{
    std::string_view label = "Connection string";
    const std::string text = Printable(connectionString);
    for (std::size_t start = 0; start < text.size();) {
        const std::size_t end = std::min(text.find(';', start), text.size() - 1) + 1;
        PrintField(terminal, 1, label, text.substr(start, end - start));
        start = end;
        label = {};
    }
}

void PrintDatabase(Terminal& terminal, const DatabaseFacts& database)
{
    PrintHeading(terminal, "Database");
    PrintField(terminal, 1, "Driver manager", database.hasDriverManager ? "there" : "missing");
    PrintField(terminal, 1, "Drivers", InWords(database.drivers));
    PrintField(terminal, 1, "Driver", DriverInWords(database));
    PrintConnectionString(terminal, database.connectionString);
    PrintField(terminal, 1, "Server", ServerInWords(database));
    for (const ReferenceSetFacts& set : database.referenceSets)
        PrintField(terminal, 1, Printable(set.name), set.rows ? Plural(*set.rows, "row") : "cannot be had");
}

void PrintFindings(Terminal& terminal, const std::vector<std::string>& findings)
{
    terminal.Line();
    if (findings.empty())
        return terminal.Line(terminal.Styled(Style::Good, "Everything answers."));
    terminal.Line(terminal.Styled(Style::Bad, Plural(findings.size(), "finding")));
    for (const std::string& finding : findings)
        terminal.Paragraph("  " + finding, 4);
}

} // namespace

void PrintPage(Terminal& terminal, const DoctorReport& report)
{
    PrintHost(terminal, report.host);
    PrintSettings(terminal, report);
    PrintDatabase(terminal, report.database);
    PrintFindings(terminal, FindingsOf(report));
}

} // namespace varnex3::tool
