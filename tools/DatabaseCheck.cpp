#include "DatabaseCheck.h"

#include <algorithm>

#include "ReadOnlyRegistry.h"
#include "varnex3/core/Conversions.h"
#include "varnex3/services/DriverConnection.h"
#include "varnex3/services/Odbc.h"
#include "varnex3/services/ProcedureCall.h"

namespace varnex3::tool {

namespace {

using Clock = std::chrono::steady_clock;

constexpr std::chrono::seconds kCommandLimit{10};
constexpr TextView kReferenceSets[] = {u"REPAIRMODELTYPE", u"ERRORSEVERITY"};

Text MaskedConnectionString(ConnectionSettings settings)
{
    if (!settings.password.empty())
        settings.password = u"***";
    return ComposeConnectionString(settings);
}

// Why a call gave no rows at all.
Text ReasonOf(const ProcedureCall& call)
{
    const Text message = ToText(call.Parameter(u"@ErrMsg").value);
    return message.empty() ? u"the server answers without rows" : message;
}

void Load(ReferenceSetFacts& set, DatabaseConnection& connection)
{
    ProcedureCall call(connection, u"getVarnexReferenceSet");
    call.GiveTexts({set.name, {}});
    const std::shared_ptr<RowSet> rows = call.Execute(RowSet::Form::ReadOnly);
    if (rows->IsOpen())
        set.rows = rows->Count();
    else
        set.reason = ReasonOf(call);
}

ReferenceSetFacts LoadReferenceSet(TextView name, DatabaseConnection& connection, const ConnectionSettings& settings)
{
    ReferenceSetFacts set{Text(name), {}, {}};
    try {
        Load(set, connection);
    } catch (...) {
        set.reason = WithoutPassword(CurrentError({}).Description(), settings.password);
    }
    return set;
}

void Open(DatabaseFacts& facts, DatabaseConnection& connection, const ConnectionSettings& settings)
{
    facts.isTried = true;
    const Clock::time_point start = Clock::now();
    try {
        connection.Open(DriverConnectionString(settings), kLoginTimeout);
        facts.isAnswering = true;
    } catch (...) {
        facts.reason = WithoutPassword(CurrentError({}).Description(), settings.password);
    }
    facts.duration = Clock::now() - start;
}

void Attempt(DatabaseFacts& facts, const ConnectionSettings& settings)
{
    DatabaseConnection connection;
    Open(facts, connection, settings);
    if (!facts.isAnswering)
        return;
    facts.product = connection.ServerProduct();
    connection.LimitCommands(kCommandLimit);
    for (const TextView name : kReferenceSets)
        facts.referenceSets.push_back(LoadReferenceSet(name, connection, settings));
}

} // namespace

DatabaseFacts CheckDatabase()
{
    ReadOnlyRegistry registry(SystemRegistry());
    const ConnectionSettings settings = ReadConnectionSettings(registry);

    DatabaseFacts facts;
    facts.hasDriverManager = Odbc() != nullptr;
    facts.drivers = InstalledDrivers();
    facts.wantedDriver = DriverName(settings);
    facts.driver = UsedDriver(settings);
    facts.isDriverRegistered = std::ranges::any_of(
        facts.drivers, [&](const Text& driver) { return EqualsIgnoringCase(driver, facts.driver); });
    facts.connectionString = MaskedConnectionString(settings);
    if (facts.isDriverRegistered)
        Attempt(facts, settings);
    return facts;
}

} // namespace varnex3::tool
