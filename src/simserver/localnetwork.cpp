#include "simserver/localnetwork.h"

#include <arpa/inet.h>
#include <ifaddrs.h>
#include <net/if.h>
#include <netinet/in.h>

#include <array>
#include <cstdint>
#include <cstring>
#include <memory>

namespace kdx::simserver {
namespace {

std::uint32_t numberOf(const sockaddr* name) {
    sockaddr_in address{};
    std::memcpy(&address, name, sizeof address);
    return ntohl(address.sin_addr.s_addr);
}

std::string dotted(std::uint32_t number) {
    const in_addr address{htonl(number)};
    std::array<char, INET_ADDRSTRLEN> text{};
    return ::inet_ntop(AF_INET, &address, text.data(), text.size());
}

}  // namespace

std::optional<LocalNetwork> networkOf(const std::string& address) {
    in_addr parsed{};
    if (::inet_pton(AF_INET, address.c_str(), &parsed) != 1 || parsed.s_addr == INADDR_ANY) return std::nullopt;
    const std::uint32_t wanted = ntohl(parsed.s_addr);
    ifaddrs* first = nullptr;
    if (::getifaddrs(&first) != 0) return std::nullopt;
    const std::unique_ptr<ifaddrs, decltype(&freeifaddrs)> list(first, &freeifaddrs);
    for (const ifaddrs* entry = first; entry != nullptr; entry = entry->ifa_next) {
        if (entry->ifa_addr == nullptr || entry->ifa_addr->sa_family != AF_INET || entry->ifa_netmask == nullptr) {
            continue;
        }
        const std::uint32_t mask = numberOf(entry->ifa_netmask);
        // Beside 127.0.0.1 all of its network belongs to this machine.
        if ((numberOf(entry->ifa_addr) & mask) != (wanted & mask)) continue;
        constexpr std::uint32_t kTooSmall = 0xFFFFFFFE;  // a network of two has no address left for "all"
        if (mask >= kTooSmall) return std::nullopt;
        return LocalNetwork{dotted(wanted | ~mask), ::if_nametoindex(entry->ifa_name)};
    }
    return std::nullopt;
}

}  // namespace kdx::simserver
