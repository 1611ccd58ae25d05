// What the driver is given for the settings: the composed connection string on Windows, elsewhere the one for FreeTDS.
#pragma once

#include "varnex3/core/Text.h"
#include "varnex3/services/ConnectionSettings.h"

namespace varnex3 {

// The driver that is asked for: the one of the composed string; where that is not registered FreeTDS, under the name
// that its package registers.
Text UsedDriver(const ConnectionSettings& settings);

// The connection string for that driver. Raises kConnectionFailed when host or instance are not found (not on Windows,
// where the driver looks for them).
Text DriverConnectionString(const ConnectionSettings& settings);

// A text in which *** stands for the password wherever it occurs.
Text WithoutPassword(Text text, TextView password);

} // namespace varnex3
