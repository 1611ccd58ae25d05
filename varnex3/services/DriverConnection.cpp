#include "varnex3/services/DriverConnection.h"

#include <algorithm>
#include <vector>

#include "varnex3/services/Odbc.h"
#ifndef _WIN32
#include "varnex3/services/NativeConnection.h"
#endif

namespace varnex3 {

Text WithoutPassword(Text text, TextView password)
{
    constexpr TextView kHidden = u"***";
    if (password.empty())
        return text;
    for (std::size_t i = text.find(password); i != Text::npos; i = text.find(password, i + kHidden.size()))
        text.replace(i, password.size(), kHidden);
    return text;
}

#ifdef _WIN32
Text UsedDriver(const ConnectionSettings& settings) { return Text(DriverName(settings)); }

Text DriverConnectionString(const ConnectionSettings& settings) { return ComposeConnectionString(settings); }
#else
Text UsedDriver(const ConnectionSettings& settings)
{
    const std::vector<Text> installed = InstalledDrivers();
    const auto isInstalled = [&](TextView name) {
        return std::ranges::any_of(installed, [&](TextView each) { return EqualsIgnoringCase(each, name); });
    };
    const TextView wanted = DriverName(settings);
    return Text(!isInstalled(wanted) && isInstalled(u"FreeTDS") ? u"FreeTDS" : wanted);
}

Text DriverConnectionString(const ConnectionSettings& settings)
{
    return ResolvedConnectionString(settings, UsedDriver(settings));
}
#endif

} // namespace varnex3
