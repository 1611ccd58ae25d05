// Where the workshop's database is: read from the host's settings, and composed to a connection string.
#pragma once

#include "varnex3/core/Text.h"
#include "varnex3/services/Registry.h"

namespace varnex3 {

struct ConnectionSettings
{
    Text password;
    Text databaseName;
    Text serverName; // u"(local)" for this computer
    Text instanceName;
    bool isTablet = false; // TabletUseMaster reads exactly 0; nothing depends on it
    bool usesNewerDriver = false;
};

// The settings of corvo32: those of the tablet's master when TabletUseMaster is 1, and otherwise the plain ones. What
// is not set has its default; nothing is raised. Reading UseNativeClient writes its default where it is not set.
ConnectionSettings ReadConnectionSettings(Registry& registry = SystemRegistry());

// Whether the newer driver is chosen. The version compares as text: u"6.1" is new, u"10.0" is not.
bool ChoosesNewerDriver(TextView currentVersion, TextView useNativeClient);

// u"SQL Native Client" or u"SQL Server".
TextView DriverName(const ConnectionSettings& settings);

// u"SRV\\SQLEXPRESS"; a server without an instance ends with the backslash nevertheless.
Text ServerPart(const ConnectionSettings& settings);

// u"Driver={SQL Native Client};Server=SRV\\SQLEXPRESS;Database=CrvSql;Uid=sa;Pwd=secret;". Nothing is escaped.
Text ComposeConnectionString(const ConnectionSettings& settings);

// This computer's network name, or the empty text.
Text GetLocalComputerName();

} // namespace varnex3
