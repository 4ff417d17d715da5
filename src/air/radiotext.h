#pragma once

#include <array>
#include <cstddef>
#include <cstdint>
#include <span>
#include <string>
#include <string_view>

#include "air/warnings.h"
#include "coder/fieldsizes.h"

namespace kdx::air {

/// A segment's address has four bits.
inline constexpr std::size_t kMostSegments = 16;

/// The radiotext in the segments of groups 2A and 2B (IEC 62106, 6.1.5.3), which share one counter.
class Radiotext {
public:
    /// @param numbers what came before the text: of the first text the second one is the A/B flag, then every changed
    /// text toggles that.
    void take(const std::string& text, std::string_view numbers, Warnings& warnings);
    [[nodiscard]] bool empty() const { return m_text.empty(); }

    /// How many segments the text takes. @param size as below.
    [[nodiscard]] std::size_t segments(std::size_t size) const;

    struct Segment {
        unsigned flagAndAddress = 0;  ///< the five last bits of block 2
        std::span<const std::uint8_t> characters;
    };
    /// The next segment. @param size its characters: four in 2A; two in 2B, whose 16 segments hold no more than half.
    [[nodiscard]] Segment next(std::size_t size);

private:
    std::string m_text;
    std::string m_lastText;  ///< a text that was taken away is still the one that the next is told apart from
    std::array<std::uint8_t, kRadiotextLength> m_codes{};
    std::size_t m_length = 0;  ///< the end mark included
    bool m_flag = false;
    std::size_t m_segment = 0;
};

}  // namespace kdx::air
