#pragma once

#include <optional>
#include <string>

namespace kdx::simserver {

/// The network that an address of this machine belongs to.
struct LocalNetwork {
    std::string broadcastAddress;  ///< in dotted form
    unsigned interfaceIndex = 0;   ///< of the interface that leads there
};

/// Gives nothing for an address that is no single one of this machine's (0.0.0.0), and for a network of one machine.
/// @param address IPv4 in dotted form.
std::optional<LocalNetwork> networkOf(const std::string& address);

}  // namespace kdx::simserver
