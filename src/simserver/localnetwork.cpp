#include "simserver/localnetwork.h"

#include <arpa/inet.h>

#include "vxi11/ipv4networks.h"

namespace kdx::simserver {

std::optional<LocalNetwork> networkOf(const std::string& address) {
    in_addr parsed{};
    if (::inet_pton(AF_INET, address.c_str(), &parsed) != 1 || parsed.s_addr == INADDR_ANY) return std::nullopt;
    const std::uint32_t wanted = ntohl(parsed.s_addr);
    for (const vxi11::Ipv4Network& network : vxi11::ipv4Networks()) {
        // Beside 127.0.0.1 all of its network belongs to this machine.
        if (!network.holds(wanted)) continue;
        const auto broadcast = network.broadcast();
        if (!broadcast) return std::nullopt;
        return LocalNetwork{vxi11::dotted(*broadcast), network.interface};
    }
    return std::nullopt;
}

}  // namespace kdx::simserver
