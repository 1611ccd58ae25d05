// Where a named instance of a server listens, as the server's browser service tells on UDP port 1434.
#pragma once

#include <chrono>
#include <cstdint>
#include <optional>
#include <string>
#include <string_view>

namespace varnex3 {

inline constexpr std::uint16_t kBrowserPort = 1434;

// The TCP port of an instance at an address ("127.0.0.1"). Nothing when nobody answers within the limit; a refusal ends
// the wait at once.
std::optional<std::uint16_t> LookUpInstance(const std::string& address, std::string_view instance,
                                            std::uint16_t browserPort = kBrowserPort,
                                            std::chrono::milliseconds limit = std::chrono::seconds(1));

// The TCP port that an answer tells; nothing for an answer without one, cut short or of another form.
std::optional<std::uint16_t> PortFromAnswer(std::string_view answer);

// The address of a host by name, numeric addresses as they are. A name server that does not answer is waited for one
// second. Nothing when there is no such host.
std::optional<std::string> ResolveHost(const std::string& host);

} // namespace varnex3
