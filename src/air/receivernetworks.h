#pragma once

#include <array>
#include <cstdint>
#include <optional>
#include <vector>

#include "air/receiverfrequencies.h"

namespace kdx::air {

/// What groups 14A and 14B tell of another network (IEC 62106, 6.1.5.20). What was not heard yet is empty.
struct ReceivedNetwork {
    /// Where the other network is to be found by those who listen to this one on the tuned frequency.
    struct Mapped {
        int tuned = 0;  ///< in kilohertz, as the other one
        int other = 0;
        friend bool operator==(const Mapped&, const Mapped&) = default;
    };
    std::uint16_t pi = 0;
    std::array<std::uint8_t, 8> ps{' ', ' ', ' ', ' ', ' ', ' ', ' ', ' '};  ///< codes of characters
    FrequencyList frequencies;                                               ///< method A
    std::vector<Mapped> mapped;
    std::optional<bool> tp;
    std::optional<bool> ta;
    std::optional<int> pty;
    std::optional<std::uint16_t> linkage;
    std::optional<std::uint16_t> itemNumber;
    std::uint64_t lastGroup = 0;  ///< the count of groups when it was heard last
};

/// The other networks, as they are told of.
class ReceivedNetworks {
public:
    /// A group 14A. @param bits the five last ones of block 2; @param block3 nothing when it came with errors;
    /// @param group the count of groups.
    void take14A(unsigned bits, std::optional<std::uint16_t> block3, std::uint16_t pi, std::uint64_t group);
    /// A group 14B.
    void take14B(unsigned bits, std::uint16_t pi, std::uint64_t group);
    /// In the order they were first heard.
    [[nodiscard]] const std::vector<ReceivedNetwork>& networks() const { return m_networks; }

private:
    /// What is known beside of a network: its list under way, and how old its pairs are.
    struct Beside {
        FrequencyLists lists;
        std::uint64_t turn = 0;               ///< counts how often the network's turn began
        std::vector<std::uint64_t> pairTurn;  ///< of each pair: the turn that it was heard in last
    };
    std::size_t placeOf(std::uint16_t pi, std::uint64_t group);
    void takeVariant(std::size_t place, unsigned variant, std::uint16_t word);
    void takePair(std::size_t place, ReceivedNetwork::Mapped pair);
    void beginTurn(std::size_t place);

    std::vector<ReceivedNetwork> m_networks;
    std::vector<Beside> m_beside;
};

}  // namespace kdx::air
