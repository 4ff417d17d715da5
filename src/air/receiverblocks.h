#pragma once

#include <array>
#include <cstddef>
#include <cstdint>
#include <optional>

namespace kdx::air {

/// A group as a radio gets it: a block that came with errors is missing.
struct ReceivedGroup {
    std::array<std::optional<std::uint16_t>, 4> blocks;
    friend bool operator==(const ReceivedGroup&, const ReceivedGroup&) = default;
};

/// Finds the blocks in the stream of bits, in the way of IEC 62106, annex C: two neighbouring blocks whose syndromes
/// are those of their offset words give the step; from then on it is kept, whatever single blocks are like, until too
/// many are wrong or another step is the right one. Errors are noticed, not corrected: a radio that corrects shows
/// wrong characters now and then.
class BlockReceiver {
public:
    /// Takes the next bit; a group when it was the last one of a group that a block could be read of.
    std::optional<ReceivedGroup> take(bool bit);

    [[nodiscard]] bool inStep() const { return m_inStep; }
    /// Of blocks that were in step: how many there were, and how many of them came with errors.
    [[nodiscard]] std::uint64_t blocks() const { return m_blocks; }
    [[nodiscard]] std::uint64_t wrongBlocks() const { return m_wrongBlocks; }

private:
    static constexpr unsigned kBlockBits = 26;
    /// A window of 26 bits that had the syndrome of a block.
    struct Candidate {
        std::uint64_t end = 0;  ///< the count of bits when it was complete
        std::size_t place = 0;
        std::uint16_t information = 0;
    };
    std::optional<ReceivedGroup> search(std::size_t place, std::uint16_t information);
    std::optional<ReceivedGroup> endOfBlock(std::optional<std::size_t> place, std::uint16_t information);
    std::optional<ReceivedGroup> nextPlace();

    std::uint32_t m_window = 0;  ///< the last 26 bits
    std::uint64_t m_bits = 0;
    std::array<std::optional<Candidate>, kBlockBits> m_candidates;  ///< the last one of each step
    bool m_inStep = false;
    std::uint64_t m_blockEnd = 0;  ///< the count of bits when the block under way is complete
    std::size_t m_place = 0;       ///< of the block under way, 0 to 3
    ReceivedGroup m_group;
    bool m_hasCPrime = false;
    std::uint64_t m_wrong = 0;  ///< a bit for each of the last blocks, the newest lowest: whether it came with errors
    std::uint64_t m_blocks = 0;
    std::uint64_t m_wrongBlocks = 0;
};

}  // namespace kdx::air
