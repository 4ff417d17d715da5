#pragma once

#include <chrono>
#include <optional>
#include <string_view>

namespace kdx {

/// No length of time that is written down is longer.
inline constexpr std::chrono::seconds kLongestDuration{1'000'000'000};

/// A length of time as people write it: "2 s", "1.5min", "500 ms", "1 h"; a decimal point, blanks as they like. A
/// longer one is kLongestDuration. Nothing for any other text.
[[nodiscard]] std::optional<std::chrono::milliseconds> parseDuration(std::string_view text);

}  // namespace kdx
