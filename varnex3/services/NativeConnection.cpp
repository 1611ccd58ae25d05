#include "varnex3/services/NativeConnection.h"

#include <algorithm>
#include <array>
#include <optional>

#include "varnex3/services/InstanceLookup.h"
#include "varnex3/services/Odbc.h"

namespace varnex3 {

namespace {

constexpr TextView kThisComputer = u"127.0.0.1";
constexpr TextView kDefaultPort = u"1433";

bool IsThisComputer(TextView host)
{
    constexpr std::array<TextView, 4> names{u"", u".", u"(local)", u"localhost"};
    return std::ranges::any_of(names, [&](TextView name) { return EqualsIgnoringCase(host, name); });
}

// A text and what stands behind the separator in it, if it is there.
struct Halves
{
    TextView first;
    TextView second;
};

Halves SplitAt(TextView text, char16_t separator)
{
    const std::size_t i = text.find(separator);
    return i == TextView::npos ? Halves{text, {}} : Halves{text.substr(0, i), text.substr(i + 1)};
}

// Between braces where a semicolon would end the value. The driver knows no way to write a closing brace in these.
Text Braced(TextView value)
{
    const bool needsBraces = value.find(u';') != TextView::npos || value.starts_with(u'{');
    return needsBraces ? u"{" + Text(value) + u"}" : Text(value);
}

Text PortOf(const ServerAddress& server, const std::string& address)
{
    if (!server.port.empty())
        return server.port;
    if (server.instance.empty())
        return Text(kDefaultPort);
    if (const auto port = LookUpInstance(address, ToUtf8(server.instance)))
        return ToUtf16(std::to_string(*port));
    throw Error(kConnectionFailed, {},
                u"nobody at " + Quoted(server.host) + u" tells of the instance " + Quoted(server.instance));
}

} // namespace

ServerAddress AddressOf(TextView serverPart)
{
    while (serverPart.ends_with(u'\\'))
        serverPart.remove_suffix(1);
    const auto [server, instance] = SplitAt(serverPart, u'\\');
    const auto [host, port] = SplitAt(server, u',');
    const auto [instanceName, instancePort] = SplitAt(instance, u',');
    const TextView name = Trimmed(host);
    return {Text(IsThisComputer(name) ? kThisComputer : name), Text(Trimmed(instanceName)),
            Text(Trimmed(port.empty() ? instancePort : port))};
}

Text NativeConnectionString(const ConnectionSettings& settings, TextView driver, TextView address, TextView port)
{
    return u"Driver={" + Text(driver) + u"};Server=" + Text(address) + u";Port=" + Text(port) + u";Database="
           + Braced(settings.databaseName) + u";Uid=sa;Pwd=" + Braced(settings.password)
           + u";TDS_Version=7.3;ClientCharset=UTF-8;";
}

Text ResolvedConnectionString(const ConnectionSettings& settings, TextView driver)
{
    const ServerAddress server = AddressOf(ServerPart(settings));
    const std::optional<std::string> address = ResolveHost(ToUtf8(server.host));
    if (!address)
        throw Error(kConnectionFailed, {}, u"there is no host " + Quoted(server.host));
    return NativeConnectionString(settings, driver, ToUtf16(*address), PortOf(server, *address));
}

} // namespace varnex3
