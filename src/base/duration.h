#pragma once

#include <chrono>
#include <optional>
#include <string_view>

namespace kdx {

/// A length of time as people write it: "2 s", "1.5s", "500 ms"; a decimal point, blanks as they like. Nothing for any
/// other text and for more than a day.
[[nodiscard]] std::optional<std::chrono::milliseconds> parseDuration(std::string_view text);

}  // namespace kdx
