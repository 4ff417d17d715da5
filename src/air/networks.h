#pragma once

#include <cstddef>
#include <cstdint>
#include <vector>

#include "air/warnings.h"
#include "sim/othernetworks.h"

namespace kdx::air {

/// What groups 14A and 14B tell of other networks (IEC 62106, 6.1.5.20 and 6.2.1.8).
class Networks {
public:
    struct Part {
        std::uint8_t bits = 0;      ///< the five last bits of block 2
        std::uint16_t block3 = 0;   ///< of 14A only
        std::uint16_t network = 0;  ///< its identification, in block 4
    };

    /// @param bursts whether a change of TA is announced at once.
    void take(const std::vector<sim::OtherNetwork>& networks, bool bursts, Warnings& warnings);
    [[nodiscard]] bool empty() const { return m_networks.empty(); }
    /// Groups 14A that each thing takes which is told of them: a list of method A several.
    [[nodiscard]] const std::vector<std::size_t>& lengths() const { return m_lengths; }

    /// Of 14A: all of one network, then all of the next one.
    [[nodiscard]] Part nextOf14A();
    /// Of 14B: the present state of each network in turn.
    [[nodiscard]] Part nextOf14B();
    /// Whether changes of TA are being announced, in 14B, and the next part of that.
    [[nodiscard]] bool announces() const { return !m_bursts.empty(); }
    [[nodiscard]] Part nextOfBurst();

private:
    struct Network {
        std::uint16_t pi = 0;
        bool tp = false;
        bool ta = false;
    };
    struct Burst {
        std::uint16_t pi = 0;
        int left = 0;
    };
    void follow(const std::vector<Network>& networks, bool bursts);
    void append(const sim::OtherNetwork& network, std::uint16_t pi, Warnings& warnings);
    [[nodiscard]] static Part stateOf(const Network& network);

    std::vector<Network> m_networks;
    std::vector<Part> m_parts;
    std::vector<std::size_t> m_lengths;
    std::vector<Burst> m_bursts;
    std::size_t m_nextPart = 0;
    std::size_t m_nextState = 0;
};

}  // namespace kdx::air
