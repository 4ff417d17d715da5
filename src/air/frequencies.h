#pragma once

#include <cstddef>
#include <cstdint>
#include <optional>
#include <string>
#include <string_view>
#include <vector>

#include "air/warnings.h"
#include "sim/aflists.h"

namespace kdx::air {

// Codes of alternative frequencies (IEC 62106, 6.2.1.6.1).
inline constexpr std::uint8_t kFiller = 205;
inline constexpr std::uint8_t kNoFrequencies = 224;  ///< and 224 + n: n frequencies follow
inline constexpr std::size_t kMostFrequencies = 25;

/// The code of a frequency: 1 for 87.6 to 204 for 107.9 MHz; others, and what lies between, have none.
[[nodiscard]] std::optional<std::uint8_t> frequencyCode(double megahertz);

/// A list in the pairs of codes that groups carry one after the other; a frequency without a code is left out, which
/// is told under the name.
[[nodiscard]] std::vector<std::uint16_t> methodA(std::string_view list, const std::string& name, Warnings& warnings);

/// The pairs of each of another network's lists: the tuned frequency in the upper byte, what it maps to in the lower.
[[nodiscard]] std::vector<std::uint16_t> mappedPairs(const sim::AfLists& lists, const std::string& name,
                                                     Warnings& warnings);

/// The programme's own lists as 0A sends them, one after the other and then again.
class AlternativeFrequencies {
public:
    void take(const sim::AfLists& lists, Warnings& warnings);
    /// Groups that each of the lists takes.
    [[nodiscard]] const std::vector<std::size_t>& lengths() const { return m_lengths; }
    /// Block 3 of the next group.
    [[nodiscard]] std::uint16_t next();

private:
    std::vector<std::uint16_t> m_pairs;
    std::vector<std::size_t> m_lengths;
    std::size_t m_next = 0;
};

}  // namespace kdx::air
