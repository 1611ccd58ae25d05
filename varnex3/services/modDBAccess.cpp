#include "varnex3/services/modDBAccess.h"

#include <utility>
#include <vector>

#include "varnex3/core/Conversions.h"
#include "varnex3/services/DatabaseConnection.h"
#include "varnex3/services/DriverConnection.h"
#include "varnex3/services/ProcedureCall.h"

namespace varnex3 {

namespace {

using Clock = std::chrono::steady_clock;
using namespace std::chrono_literals;

constexpr auto kCommandTimeout = 120s;
constexpr auto kSlow = 250ms;
constexpr auto kPause = 30s;
constexpr auto kPauseOfReferenceSets = 1s;
constexpr Name kExecSP = "modDBAccess.DBExecSP";
constexpr TextView kDefaultDescription = u"Application-defined or object-defined error"; // the platform's for 30010

// An attempt that failed slowly, and is not repeated for a while.
struct SlowFailure
{
    Text connectionString;
    Clock::time_point time;
};

struct ModuleState
{
    std::shared_ptr<DatabaseConnection> connection;
    std::shared_ptr<DatabaseConnection> secondReference; // what the last check found open; nothing reads it
    std::optional<ConnectFailure> failure;
    std::optional<SlowFailure> slowFailure;
    std::optional<Clock::time_point> setWithoutDatabase; // when a reference set found none, unless others tried since

    ModuleState() = default;
    ModuleState(const ModuleState&) = delete;
    ModuleState& operator=(const ModuleState&) = delete;
#ifdef _WIN32
    // A thread may end when the driver is unloaded already: the connection is left to the process.
    ~ModuleState()
    {
        new std::shared_ptr(std::move(connection));
        new std::shared_ptr(std::move(secondReference));
    }
#else
    ~ModuleState() = default;
#endif
};

ModuleState& State()
{
    thread_local ModuleState state;
    return state;
}

bool IsPausing(const Text& connectionString)
{
    const std::optional<SlowFailure>& slow = State().slowFailure;
    return slow && slow->connectionString == connectionString && Clock::now() - slow->time < kPause;
}

// Records ask for a set each time one is made: a quote would take longer to ask in vain than to be read.
bool SetsArePausing()
{
    const std::optional<Clock::time_point>& since = State().setWithoutDatabase;
    return since && Clock::now() - *since < kPauseOfReferenceSets;
}

void RememberFailure(const Text& reason, const ConnectionSettings& settings, Clock::time_point start)
{
    const auto duration = std::chrono::duration_cast<std::chrono::milliseconds>(Clock::now() - start);
    State().failure = {WithoutPassword(reason, settings.password), duration};
    if (duration > kSlow)
        State().slowFailure = {ComposeConnectionString(settings), Clock::now()};
}

void Open(const ConnectionSettings& settings)
{
    const auto start = Clock::now();
    try {
        auto connection = std::make_shared<DatabaseConnection>();
        connection->Open(DriverConnectionString(settings), kLoginTimeout);
        connection->LimitCommands(kCommandTimeout);
        State().connection = std::move(connection);
        State().failure.reset();
        State().slowFailure.reset();
    } catch (...) {
        RememberFailure(CurrentError({}).Description(), settings, start);
    }
}

bool IsOpen() { return State().connection && State().connection->IsOpen(); }

void DropConnection()
{
    State().connection.reset();
    State().secondReference.reset();
    State().slowFailure.reset(); // try at once
}

// The texts between the tabs; an empty text has none.
std::vector<TextView> SplitAtTabs(TextView text)
{
    std::vector<TextView> parts;
    if (text.empty())
        return parts;
    for (std::size_t tab = text.find(u'\t'); tab != TextView::npos; tab = text.find(u'\t')) {
        parts.push_back(text.substr(0, tab));
        text.remove_prefix(tab + 1);
    }
    parts.push_back(text);
    return parts;
}

Variant Output(const ProcedureCall& call, TextView parameter) { return DBParamValue(&call.Parameter(parameter)); }

std::int32_t Identifier(const ProcedureCall& call) { return ToInt32(Output(call, u"@ID")); }

[[noreturn]] void RaiseOf(const ProcedureCall& call)
{
    const Text text = ToText(Output(call, u"@ErrMsg"));
    Raise(kProcedureFailed, kExecSP, text.empty() ? Text(kDefaultDescription) : text);
}

// Without a row set the outcome is what @ErrNo says.
void TakeOutcome(const ProcedureCall& call, std::int32_t& lID)
{
    if (ToDouble(Output(call, u"@ErrNo")) < 0)
        RaiseOf(call);
    lID = Identifier(call);
}

std::shared_ptr<RowSet> Execute(TextView sProcName, TextView sParams, std::int32_t& lID, bool bUpdatable)
{
    ProcedureCall call(*State().connection, sProcName);
    call.GiveTexts(SplitAtTabs(sParams));
    auto rowSet = call.Execute(bUpdatable ? RowSet::Form::Updatable : RowSet::Form::ReadOnly);
    if (!rowSet->IsOpen())
        TakeOutcome(call, lID);
    else if (rowSet->Count() > 0)
        lID = Identifier(call);
    return rowSet;
}

} // namespace

bool DBConnect()
{
    State().connection.reset();
    State().setWithoutDatabase.reset();
    const ConnectionSettings settings = ReadConnectionSettings();
    if (!IsPausing(ComposeConnectionString(settings)))
        Open(settings);
    return IsOpen();
}

bool DBIsConnected()
{
    if (!IsOpen())
        DBConnect();
    if (!IsOpen())
        return false;
    State().secondReference = State().connection;
    return true;
}

Variant DBParamValue(const ProcedureParameter* parameter) { return parameter == nullptr ? Empty : parameter->value; }

std::shared_ptr<RowSet> DBExecSP(TextView sProcName, TextView sParams, std::int32_t& lID, const bool& bReconnect,
                                 const bool& bUpdatable)
{
    if (bReconnect)
        DropConnection();
    if (!DBIsConnected())
        return nullptr;
    try {
        return Execute(sProcName, sParams, lID, bUpdatable);
    } catch (const Error& error) {
        throw error.About(kExecSP, {});
    }
}

std::shared_ptr<RowSet> GetReferenceSet(TextView first, TextView second)
{
    if (SetsArePausing())
        return std::make_shared<RowSet>();
    std::int32_t lID = 0;
    auto rowSet = DBExecSP(u"getVarnexReferenceSet", Text(first) + u"\t" + Text(second), lID, false, false);
    if (rowSet)
        return rowSet;
    State().setWithoutDatabase = Clock::now();
    return std::make_shared<RowSet>();
}

std::optional<ConnectFailure> LastConnectFailure() { return State().failure; }

} // namespace varnex3
