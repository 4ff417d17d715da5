#include "air/receiverblocks.h"

#include <bit>
#include <utility>

namespace kdx::air {

namespace {

constexpr unsigned kCheckBits = 10;
constexpr std::uint16_t kVersionB = 0x0800;
constexpr std::size_t kThird = 2;

// The parity-check matrix (IEC 62106, annex B): what each of a block's 26 bits adds to the syndrome, the first bit
// first.
constexpr std::array<std::uint16_t, 26> kParity = {
    0b1000000000, 0b0100000000, 0b0010000000, 0b0001000000, 0b0000100000, 0b0000010000, 0b0000001000,
    0b0000000100, 0b0000000010, 0b0000000001, 0b1011011100, 0b0101101110, 0b0010110111, 0b1010000111,
    0b1110011111, 0b1100010011, 0b1101010101, 0b1101110110, 0b0110111011, 0b1000000001, 0b1111011100,
    0b0111101110, 0b0011110111, 0b1010100111, 0b1110001111, 0b1100011011};

// The syndromes of the offset words (annex B) and the places of their blocks.
struct Syndrome {
    std::uint16_t value;
    std::size_t place;
};
constexpr std::uint16_t kSyndromeOfCPrime = 0b1111001100;
constexpr std::array kSyndromes = {Syndrome{0b1111011000, 0}, Syndrome{0b1111010100, 1}, Syndrome{0b1001011100, 2},
                                   Syndrome{kSyndromeOfCPrime, 2}, Syndrome{0b1001011000, 3}};

constexpr std::uint16_t syndromeOf(std::uint32_t window) {
    std::uint16_t syndrome = 0;
    for (std::size_t bit = 0; bit < kParity.size(); ++bit) {
        if ((window >> (kParity.size() - 1 - bit) & 1U) != 0) syndrome ^= kParity[bit];
    }
    return syndrome;
}

constexpr std::optional<std::size_t> placeOf(std::uint16_t syndrome) {
    for (const auto& [value, place] : kSyndromes) {
        if (value == syndrome) return place;
    }
    return std::nullopt;
}

// Of the last 50 blocks 45 wrong ones: that is noise.
constexpr std::uint64_t kLastFifty = (std::uint64_t{1} << 50U) - 1;
constexpr int kMostWrong = 45;
// So many wrong blocks in a row, and another step is believed.
constexpr std::uint64_t kLastFive = 0x1F;

}  // namespace

std::optional<ReceivedGroup> BlockReceiver::take(bool bit) {
    constexpr std::uint32_t kWindow = (1U << kBlockBits) - 1;
    m_window = (m_window << 1U | (bit ? 1U : 0U)) & kWindow;
    if (++m_bits < kBlockBits) return std::nullopt;
    const bool isEnd = m_inStep && m_bits == m_blockEnd;
    const bool searches = !m_inStep || (m_wrong & kLastFive) == kLastFive;
    if (!isEnd && !searches) return std::nullopt;
    const std::uint16_t syndrome = syndromeOf(m_window);
    const auto place = placeOf(syndrome);
    const auto information = static_cast<std::uint16_t>(m_window >> kCheckBits);
    m_hasCPrime = syndrome == kSyndromeOfCPrime;
    if (isEnd) return endOfBlock(place, information);
    return place ? search(*place, information) : std::nullopt;
}

/// Two blocks that follow each other as they should are the first ones of a step.
std::optional<ReceivedGroup> BlockReceiver::search(std::size_t place, std::uint16_t information) {
    auto& candidate = m_candidates.at(m_bits % kBlockBits);
    const auto before = std::exchange(candidate, Candidate{m_bits, place, information});
    if (!before || before->end + kBlockBits != m_bits || (before->place + 1) % 4 != place) return std::nullopt;
    m_inStep = true;
    m_wrong = 0;
    m_candidates = {};
    m_blocks += 2;
    m_group = {};
    if (place != 0) m_group.blocks.at(before->place) = before->information;
    m_group.blocks.at(place) = information;
    m_blockEnd = m_bits;
    m_place = place;
    return nextPlace();
}

std::optional<ReceivedGroup> BlockReceiver::endOfBlock(std::optional<std::size_t> place, std::uint16_t information) {
    bool right = place == m_place;
    // The third block has C' in a group of version B and there only.
    if (right && m_place == kThird && m_group.blocks[1]) right = ((*m_group.blocks[1] & kVersionB) != 0) == m_hasCPrime;
    ++m_blocks;
    if (right) {
        m_group.blocks.at(m_place) = information;
    } else {
        ++m_wrongBlocks;
    }
    m_wrong = m_wrong << 1U | (right ? 0U : 1U);
    if (std::popcount(m_wrong & kLastFifty) >= kMostWrong) m_inStep = false;
    return nextPlace();
}

/// Gives the group when the block was its last one.
std::optional<ReceivedGroup> BlockReceiver::nextPlace() {
    m_blockEnd += kBlockBits;
    m_place = (m_place + 1) % 4;
    if (m_place != 0) return std::nullopt;
    const ReceivedGroup group = std::exchange(m_group, {});
    return group == ReceivedGroup{} ? std::nullopt : std::optional(group);
}

}  // namespace kdx::air
