#include "varnex3/services/ConnectionSettings.h"

#include <array>
#include <string>

#ifdef _WIN32
#include <windows.h>
#else
#include <unistd.h>
#endif

#include "varnex3/services/ModRegistry.h"

namespace varnex3 {

namespace {

constexpr std::size_t kNameRoom = 512;

Text AppSetting(TextView key, const Text& defaultValue, Registry& registry)
{
    return GetAppSetting(u"corvo32", u"frmsplash", key, defaultValue, true, registry);
}

void ReadPlace(ConnectionSettings& settings, const Text& prefix, Registry& registry)
{
    settings.password = AppSetting(prefix + u"SAPwd", u"", registry);
    settings.databaseName = AppSetting(prefix + u"DatabaseName", u"CrvSql", registry);
    settings.instanceName = AppSetting(prefix + u"InstanceName", u"", registry);
    settings.serverName = AppSetting(prefix + u"ServerName", u"(local)", registry);
}

} // namespace

ConnectionSettings ReadConnectionSettings(Registry& registry)
{
    ConnectionSettings settings;
    if (AppSetting(u"TabletUseMaster", u"", registry) == u"1") {
        ReadPlace(settings, u"TabletMaster", registry);
    } else {
        settings.isTablet = AppSetting(u"TabletUseMaster", u"", registry) == u"0";
        ReadPlace(settings, u"", registry);
    }
    if (GetLocalComputerName() == settings.serverName) // in the same letter case
        settings.serverName = u"(local)";

    const Text version =
        GetAppSetting(u"Microsoft", u"Windows NT\\CurrentVersion", u"CurrentVersion", u"", false, registry);
    const Text useNativeClient = GetAppSetting(u"corvo32", u"frmSplash", u"UseNativeClient", u"0", false, registry);
    settings.usesNewerDriver = ChoosesNewerDriver(version, useNativeClient);
    return settings;
}

bool ChoosesNewerDriver(TextView currentVersion, TextView useNativeClient)
{
    return currentVersion >= u"6.0" || useNativeClient == u"1"; // character by character
}

TextView DriverName(const ConnectionSettings& settings)
{
    return settings.usesNewerDriver ? u"SQL Native Client" : u"SQL Server";
}

Text ServerPart(const ConnectionSettings& settings)
{
    const bool isSeparated = settings.serverName.ends_with(u'\\');
    return settings.serverName + (isSeparated ? u"" : u"\\") + settings.instanceName;
}

Text ComposeConnectionString(const ConnectionSettings& settings)
{
    return u"Driver={" + Text(DriverName(settings)) + u"};Server=" + ServerPart(settings) + u";Database="
           + settings.databaseName + u";Uid=sa;Pwd=" + settings.password + u";";
}

#ifdef _WIN32
Text GetLocalComputerName()
{
    std::array<wchar_t, kNameRoom> name{};
    auto length = static_cast<DWORD>(name.size());
    return GetComputerNameW(name.data(), &length) != 0 ? Text(name.begin(), name.begin() + length) : Text();
}
#else
Text GetLocalComputerName()
{
    std::array<char, kNameRoom> name{};
    return gethostname(name.data(), name.size() - 1) == 0 ? FromCodePage(name.data()) : Text();
}
#endif

} // namespace varnex3
