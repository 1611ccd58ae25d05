// The connection string for FreeTDS, the SQL Server driver where there is none of Windows.
//
// That driver has its own view of the server part: it takes the backslash behind a server without an instance for an
// instance, knows no (local), and waits long for names that nobody answers. So host, instance and port are found here.
#pragma once

#include <cstdint>
#include <string>

#include "varnex3/core/Text.h"
#include "varnex3/services/ConnectionSettings.h"

namespace varnex3 {

// u"SRV\\SQLEXPRESS", u"SRV,1433", u"(local)\\" taken apart.
struct ServerAddress
{
    Text host;     // u"127.0.0.1" for the names of this computer
    Text instance; // empty for the default one
    Text port;     // as written; empty when none is

    friend bool operator==(const ServerAddress&, const ServerAddress&) = default;
};

ServerAddress AddressOf(TextView serverPart);

// u"Driver={SQL Server};Server=10.0.0.7;Port=1433;Database=CrvSql;Uid=sa;Pwd=secret;TDS_Version=7.3;
// ClientCharset=UTF-8;". The version is pinned because the driver hangs when it guesses it of a server that is silent.
// A value may have a semicolon or a closing brace, not both.
Text NativeConnectionString(const ConnectionSettings& settings, TextView driver, TextView address, TextView port);

// The same for the settings, host and instance looked up: each takes a second at most. Raises kConnectionFailed when
// there is no such host or nobody tells of the instance.
Text ResolvedConnectionString(const ConnectionSettings& settings, TextView driver);

} // namespace varnex3
