#pragma once

#include <charconv>
#include <cstdint>
#include <string_view>

namespace kdx::air {

/// The word that hexadecimal digits stand for; 0 for what is none.
[[nodiscard]] inline std::uint16_t hexWord(std::string_view digits) {
    std::uint16_t word = 0;
    std::from_chars(digits.data(), digits.data() + digits.size(), word, 16);
    return word;
}

}  // namespace kdx::air
