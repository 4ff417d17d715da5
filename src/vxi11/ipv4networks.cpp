#include "vxi11/ipv4networks.h"

namespace kdx::vxi11 {

std::optional<std::uint32_t> Ipv4Network::broadcast() const {
    constexpr std::uint32_t kTooSmall = 0xFFFFFFFE;
    return mask < kTooSmall ? std::optional(address | ~mask) : std::nullopt;
}

std::string dotted(std::uint32_t address) {
    std::string text;
    for (unsigned shift = 32; shift > 0; shift -= 8) {
        if (!text.empty()) text += '.';
        text += std::to_string(address >> (shift - 8) & 0xFFU);
    }
    return text;
}

}  // namespace kdx::vxi11
