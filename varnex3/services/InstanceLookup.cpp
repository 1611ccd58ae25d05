#include "varnex3/services/InstanceLookup.h"

#include <array>
#include <charconv>
#include <memory>
#include <system_error>

#include <netdb.h>
#include <poll.h>
#include <resolv.h>
#include <sys/socket.h>
#include <unistd.h>

namespace varnex3 {

namespace {

constexpr char kAskForOne = 4;
constexpr char kAnswer = 5;
constexpr std::size_t kAnswerHead = 3; // the kind and the length of the text
constexpr std::size_t kLongestAnswer = 1024 + kAnswerHead;

using Addresses = std::unique_ptr<addrinfo, decltype(&freeaddrinfo)>;

Addresses AddressesOf(const std::string& host, const char* service, int flags, int kind)
{
    addrinfo hints{};
    hints.ai_flags = flags;
    hints.ai_socktype = kind;
    addrinfo* found = nullptr;
    const bool isFound = getaddrinfo(host.c_str(), service, &hints, &found) == 0;
    return {isFound ? found : nullptr, &freeaddrinfo};
}

// This thread asks each name server once and waits a second; as before afterwards.
class ShortPatience
{
public:
    ShortPatience()
    {
        if ((_res.options & RES_INIT) == 0)
            res_init();
        retransmission = _res.retrans;
        tries = _res.retry;
        _res.retrans = 1;
        _res.retry = 1;
    }
    ~ShortPatience()
    {
        _res.retrans = retransmission;
        _res.retry = tries;
    }
    ShortPatience(const ShortPatience&) = delete;
    ShortPatience& operator=(const ShortPatience&) = delete;

private:
    int retransmission;
    int tries;
};

class Socket
{
public:
    explicit Socket(int descriptor_) : descriptor(descriptor_) {}
    ~Socket()
    {
        if (descriptor >= 0)
            close(descriptor);
    }
    Socket(const Socket&) = delete;
    Socket& operator=(const Socket&) = delete;

    int Descriptor() const { return descriptor; }

private:
    int descriptor;
};

// Connected, so that the refusal of a host without the service is received.
bool Ask(const Socket& socket, const addrinfo& address, std::string_view instance)
{
    const std::string question = kAskForOne + std::string(instance) + '\0';
    return connect(socket.Descriptor(), address.ai_addr, address.ai_addrlen) == 0
           && send(socket.Descriptor(), question.data(), question.size(), MSG_NOSIGNAL) >= 0;
}

std::optional<std::string> Answer(const Socket& socket, std::chrono::milliseconds limit)
{
    pollfd waiting{socket.Descriptor(), POLLIN, 0};
    if (poll(&waiting, 1, static_cast<int>(limit.count())) != 1)
        return std::nullopt;
    std::array<char, kLongestAnswer> buffer{};
    const ssize_t length = recv(socket.Descriptor(), buffer.data(), buffer.size(), MSG_DONTWAIT);
    return length > 0 ? std::optional(std::string(buffer.data(), static_cast<std::size_t>(length))) : std::nullopt;
}

// Takes the text before the next semicolon.
std::string_view TakePart(std::string_view& rest)
{
    const std::size_t end = rest.find(';');
    const std::string_view part = rest.substr(0, end);
    rest.remove_prefix(end == std::string_view::npos ? rest.size() : end + 1);
    return part;
}

std::optional<std::uint16_t> PortFrom(std::string_view digits)
{
    std::uint16_t port = 0;
    const auto [end, fault] = std::from_chars(digits.data(), digits.data() + digits.size(), port);
    const bool isWhole = fault == std::errc() && end == digits.data() + digits.size() && port != 0;
    return isWhole ? std::optional(port) : std::nullopt;
}

} // namespace

std::optional<std::uint16_t> PortFromAnswer(std::string_view answer)
{
    if (answer.size() < kAnswerHead || answer.front() != kAnswer)
        return std::nullopt;
    std::string_view rest = answer.substr(kAnswerHead);
    while (!rest.empty()) {
        const std::string_view name = TakePart(rest);
        const std::string_view value = TakePart(rest);
        if (name == "tcp")
            return PortFrom(value);
    }
    return std::nullopt;
}

std::optional<std::uint16_t> LookUpInstance(const std::string& address, std::string_view instance,
                                            std::uint16_t browserPort, std::chrono::milliseconds limit)
{
    const Addresses found =
        AddressesOf(address, std::to_string(browserPort).c_str(), AI_NUMERICHOST | AI_NUMERICSERV, SOCK_DGRAM);
    if (!found)
        return std::nullopt;
    const Socket socket(::socket(found->ai_family, SOCK_DGRAM | SOCK_CLOEXEC, 0));
    if (!Ask(socket, *found, instance))
        return std::nullopt;
    const std::optional<std::string> answer = Answer(socket, limit);
    return answer ? PortFromAnswer(*answer) : std::nullopt;
}

std::optional<std::string> ResolveHost(const std::string& host)
{
    const ShortPatience patience;
    const Addresses found = AddressesOf(host, nullptr, 0, SOCK_STREAM);
    const addrinfo* chosen = found.get();
    for (const addrinfo* address = chosen; address != nullptr; address = address->ai_next)
        if (address->ai_family == AF_INET) {
            chosen = address; // the driver takes these in every version
            break;
        }
    std::array<char, NI_MAXHOST> text{};
    if (chosen == nullptr
        || getnameinfo(chosen->ai_addr, chosen->ai_addrlen, text.data(), text.size(), nullptr, 0, NI_NUMERICHOST) != 0)
        return std::nullopt;
    return text.data();
}

} // namespace varnex3
