#pragma once

#include <array>
#include <cstddef>
#include <string>
#include <string_view>

#include "sim/errorqueue.h"

namespace kdx::sim {

/// The AF lists of one programme, kept as they were sent: for method A the tuned frequency and its alternatives, for
/// method B the tuned frequency and then pairs that repeat it.
class AfLists {
public:
    static constexpr std::size_t kCount = 5;
    /// The tuned frequency and 25 more, what one list can carry on the air.
    static constexpr std::size_t kMaxFrequencies = 26;
    /// Bytes of a list's text: some for every frequency ("108.0,") and for the blanks or digits that users add.
    static constexpr std::size_t kMaxLength = 10 * kMaxFrequencies;

    /// Takes over "N,list" (a new set of lists begins) or "+,list" (appended to the lists there are). A list is decimal
    /// MHz joined by commas: the tuned frequency (86 to 108), then alternatives (87.5 to 108.0 or the tuned one).
    ScpiError receive(std::string_view value);

    /// Checks a list without its leading "N," or "+,".
    [[nodiscard]] static ScpiError check(std::string_view list);

    /// The list as sent; @param index 0 to 4; "" when there is none.
    [[nodiscard]] const std::string& list(std::size_t index) const { return m_lists[index]; }

private:
    std::array<std::string, kCount> m_lists;
    std::size_t m_used = 0;
};

}  // namespace kdx::sim
