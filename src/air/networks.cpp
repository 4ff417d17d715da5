#include "air/networks.h"

#include <algorithm>
#include <array>
#include <utility>

#include "air/characters.h"
#include "air/frequencies.h"
#include "air/group14.h"
#include "air/hexword.h"

namespace kdx::air {

namespace {

constexpr int kBurst = 8;  // the standard's most; at four groups the last receiver has noticed
constexpr unsigned kPairVariants = group14::kLastPair - group14::kFirstPair + 1;

}  // namespace

void Networks::take(const std::vector<sim::OtherNetwork>& networks, bool bursts, Warnings& warnings) {
    std::vector<Network> present;
    m_parts.clear();
    m_lengths.clear();
    for (const sim::OtherNetwork& network : networks) {
        present.push_back({hexWord(network.pi), network.tp, network.ta});
        append(network, present.back().pi, warnings);
    }
    follow(present, bursts);
    m_networks = std::move(present);
    if (m_nextPart >= m_parts.size()) m_nextPart = 0;
    if (m_nextState >= m_networks.size()) m_nextState = 0;
}

/// Begins a burst for each change of TA, ends those of networks that are gone.
void Networks::follow(const std::vector<Network>& networks, bool bursts) {
    const auto remove = [this](auto isOver) {
        m_bursts.erase(std::remove_if(m_bursts.begin(), m_bursts.end(), isOver), m_bursts.end());
    };
    const auto find = [](const std::vector<Network>& among, std::uint16_t pi) {
        return std::find_if(among.begin(), among.end(), [pi](const Network& network) { return network.pi == pi; });
    };
    remove([&](const Burst& burst) { return !bursts || find(networks, burst.pi) == networks.end(); });
    if (!bursts) return;
    for (const Network& network : networks) {
        const auto before = find(m_networks, network.pi);
        if (network.ta == (before != m_networks.end() && before->ta)) continue;
        remove([&](const Burst& burst) { return burst.pi == network.pi; });
        m_bursts.push_back({network.pi, kBurst});
    }
}

void Networks::append(const sim::OtherNetwork& network, std::uint16_t pi, Warnings& warnings) {
    const std::string name = "EON " + network.pi;
    const auto addPart = [&](unsigned variant, std::uint16_t block3) {
        m_parts.push_back({static_cast<std::uint8_t>((network.tp ? group14::kTp : 0U) | variant), block3, pi});
    };
    const auto add = [&](unsigned variant, std::uint16_t block3) {
        addPart(variant, block3);
        m_lengths.push_back(1);
    };
    std::array<std::uint8_t, kPsLength> ps{};
    writeCodes(network.ps, ps, name + " PS", warnings);
    for (std::size_t i = 0; i < ps.size() / 2; ++i)
        add(static_cast<unsigned>(i), pairOf(ps.at(2 * i), ps.at(2 * i + 1)));
    const auto list = methodA(network.methodA, name + " AF method A", warnings);
    for (const std::uint16_t codes : list) addPart(group14::kMethodA, codes);
    if (!list.empty()) m_lengths.push_back(list.size());
    unsigned number = 0;
    for (const std::uint16_t pair : mappedPairs(network.lists, name + " AF", warnings))
        add(group14::kFirstPair + number++ % kPairVariants, pair);
    add(group14::kTypeAndTa,
        static_cast<std::uint16_t>(static_cast<unsigned>(network.pty) << group14::kPtyPlace | (network.ta ? 1U : 0U)));
}

Networks::Part Networks::stateOf(const Network& network) {
    return {static_cast<std::uint8_t>((network.tp ? group14::kTp : 0U) | (network.ta ? group14::kTaOf14B : 0U)), 0,
            network.pi};
}

Networks::Part Networks::nextOf14A() {
    const Part part = m_parts[m_nextPart];
    m_nextPart = (m_nextPart + 1) % m_parts.size();
    return part;
}

Networks::Part Networks::nextOf14B() {
    const Part part = stateOf(m_networks[m_nextState]);
    m_nextState = (m_nextState + 1) % m_networks.size();
    return part;
}

Networks::Part Networks::nextOfBurst() {
    Burst& burst = m_bursts.front();
    const auto network = std::find_if(m_networks.begin(), m_networks.end(),
                                      [&burst](const Network& candidate) { return candidate.pi == burst.pi; });
    const Part part = stateOf(*network);
    if (--burst.left == 0) m_bursts.erase(m_bursts.begin());
    return part;
}

}  // namespace kdx::air
