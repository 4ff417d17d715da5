#include "vxi11/ipv4networks.h"

#include <ifaddrs.h>
#include <net/if.h>
#include <netinet/in.h>

#include <cstring>
#include <memory>

namespace kdx::vxi11 {

namespace {

std::uint32_t numberOf(const sockaddr* name) {
    sockaddr_in address{};
    std::memcpy(&address, name, sizeof address);
    return ntohl(address.sin_addr.s_addr);
}

}  // namespace

std::vector<Ipv4Network> ipv4Networks() {
    std::vector<Ipv4Network> networks;
    ifaddrs* first = nullptr;
    if (::getifaddrs(&first) != 0) return networks;
    const std::unique_ptr<ifaddrs, decltype(&freeifaddrs)> list(first, &freeifaddrs);
    for (const ifaddrs* entry = first; entry != nullptr; entry = entry->ifa_next) {
        if ((entry->ifa_flags & IFF_UP) == 0 || entry->ifa_addr == nullptr || entry->ifa_netmask == nullptr ||
            entry->ifa_addr->sa_family != AF_INET) {
            continue;
        }
        networks.push_back(
            {numberOf(entry->ifa_addr), numberOf(entry->ifa_netmask), ::if_nametoindex(entry->ifa_name)});
    }
    return networks;
}

}  // namespace kdx::vxi11
