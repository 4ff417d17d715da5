#pragma once

#include <cstdint>
#include <optional>
#include <string>
#include <vector>

namespace kdx::vxi11 {

/// A network that this machine is in. Addresses are numbers in the machine's byte order.
struct Ipv4Network {
    std::uint32_t address;  ///< this machine's own
    std::uint32_t mask;
    unsigned interface;  ///< its number

    [[nodiscard]] bool holds(std::uint32_t other) const { return (address & mask) == (other & mask); }
    /// Where everybody in it hears; nothing in a network of two, which has no address left for that.
    [[nodiscard]] std::optional<std::uint32_t> broadcast() const;
};

/// All that are up; none when the system does not tell.
[[nodiscard]] std::vector<Ipv4Network> ipv4Networks();

/// The address as people write it: 192.168.1.5.
[[nodiscard]] std::string dotted(std::uint32_t address);

}  // namespace kdx::vxi11
