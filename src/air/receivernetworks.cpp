#include "air/receivernetworks.h"

#include <algorithm>

#include "air/group14.h"

namespace kdx::air {

namespace {

// No country has so many programmes to be heard at one place; what is beyond was not received as it was sent.
constexpr std::size_t kMostNetworks = 256;

}  // namespace

/// Of a network that is heard for the first time the last place.
std::size_t ReceivedNetworks::placeOf(std::uint16_t pi, std::uint64_t group) {
    const auto isNetwork = [pi](const ReceivedNetwork& network) { return network.pi == pi; };
    const auto found = std::find_if(m_networks.begin(), m_networks.end(), isNetwork);
    auto place = static_cast<std::size_t>(found - m_networks.begin());
    if (found == m_networks.end()) {
        if (place == kMostNetworks) {
            m_networks.erase(m_networks.begin());
            m_beside.erase(m_beside.begin());
            --place;
        }
        m_networks.emplace_back().pi = pi;
        m_beside.emplace_back();
    }
    m_networks[place].lastGroup = group;
    return place;
}

void ReceivedNetworks::take14A(unsigned bits, std::optional<std::uint16_t> block3, std::uint16_t pi,
                               std::uint64_t group) {
    const std::size_t place = placeOf(pi, group);
    m_networks[place].tp = (bits & group14::kTp) != 0;
    const unsigned variant = bits & group14::kVariant;
    if (variant == 0) beginTurn(place);
    if (variant == group14::kMethodA) {
        m_beside[place].lists.take(block3);
        m_networks[place].frequencies = m_beside[place].lists.latest();
    } else if (block3) {
        takeVariant(place, variant, *block3);
    }
}

void ReceivedNetworks::takeVariant(std::size_t place, unsigned variant, std::uint16_t word) {
    constexpr unsigned kByte = 0xFF;
    ReceivedNetwork& network = m_networks[place];
    const unsigned upper = word >> 8U;
    const unsigned lower = word & kByte;
    if (variant <= group14::kLastOfPs) {
        network.ps.at(std::size_t{2} * variant) = static_cast<std::uint8_t>(upper);
        network.ps.at(std::size_t{2} * variant + 1) = static_cast<std::uint8_t>(lower);
    } else if (variant >= group14::kFirstPair && variant <= group14::kLastPair) {
        takePair(place, {vhfKilohertz(upper), vhfKilohertz(lower)});
    } else if (variant == group14::kAmPair) {
        takePair(place, {vhfKilohertz(upper), amKilohertz(lower)});
    } else if (variant == group14::kLinkage) {
        network.linkage = word;
    } else if (variant == group14::kTypeAndTa) {
        network.pty = static_cast<int>(word >> group14::kPtyPlace);
        network.ta = (word & 1U) != 0;
    } else if (variant == group14::kItemNumber) {
        network.itemNumber = word;
    }
}

void ReceivedNetworks::takePair(std::size_t place, ReceivedNetwork::Mapped pair) {
    if (pair.tuned == 0 || pair.other == 0) return;
    auto& pairs = m_networks[place].mapped;
    Beside& beside = m_beside[place];
    const auto known = std::find(pairs.begin(), pairs.end(), pair);
    const auto index = static_cast<std::size_t>(known - pairs.begin());
    if (known == pairs.end()) {
        pairs.push_back(pair);
        beside.pairTurn.emplace_back();
    }
    beside.pairTurn[index] = beside.turn;
}

/// A pair that three turns of its network went without is no longer sent.
void ReceivedNetworks::beginTurn(std::size_t place) {
    constexpr std::uint64_t kLongestAway = 3;
    auto& pairs = m_networks[place].mapped;
    Beside& beside = m_beside[place];
    ++beside.turn;
    for (std::size_t at = pairs.size(); at-- > 0;) {
        if (beside.turn - beside.pairTurn[at] <= kLongestAway) continue;
        pairs.erase(pairs.begin() + static_cast<std::ptrdiff_t>(at));
        beside.pairTurn.erase(beside.pairTurn.begin() + static_cast<std::ptrdiff_t>(at));
    }
}

void ReceivedNetworks::take14B(unsigned bits, std::uint16_t pi, std::uint64_t group) {
    ReceivedNetwork& network = m_networks[placeOf(pi, group)];
    network.tp = (bits & group14::kTp) != 0;
    network.ta = (bits & group14::kTaOf14B) != 0;
}

}  // namespace kdx::air
