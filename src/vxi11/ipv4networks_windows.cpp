#include <winsock2.h>

#include <ws2tcpip.h>

#include <array>

#include "vxi11/ipv4networks.h"

namespace kdx::vxi11 {

std::vector<Ipv4Network> ipv4Networks() {
    std::vector<Ipv4Network> networks;
    WSADATA ignored;
    if (WSAStartup(MAKEWORD(2, 2), &ignored) != 0) return networks;
    const SOCKET asked = socket(AF_INET, SOCK_DGRAM, IPPROTO_UDP);
    std::array<INTERFACE_INFO, 64> found;
    DWORD bytes = 0;
    if (asked != INVALID_SOCKET && WSAIoctl(asked, SIO_GET_INTERFACE_LIST, nullptr, 0, found.data(), sizeof found,
                                            &bytes, nullptr, nullptr) == 0) {
        for (std::size_t i = 0; i < bytes / sizeof(INTERFACE_INFO); ++i) {
            const INTERFACE_INFO& entry = found[i];
            if ((entry.iiFlags & IFF_UP) == 0 || entry.iiAddress.Address.sa_family != AF_INET) continue;
            networks.push_back({ntohl(entry.iiAddress.AddressIn.sin_addr.s_addr),
                                ntohl(entry.iiNetmask.AddressIn.sin_addr.s_addr), 0});  // numbered nowhere here
        }
    }
    if (asked != INVALID_SOCKET) closesocket(asked);
    WSACleanup();
    return networks;
}

}  // namespace kdx::vxi11
