#pragma once

#include <cstddef>
#include <cstdint>
#include <optional>
#include <string>
#include <string_view>
#include <vector>

namespace kdx::scenario {

/// A decimal number counted in millionths: what is written as 0.1 is 0.1, however often it is added.
struct Decimal {
    static constexpr std::int64_t kOne = 1'000'000;
    std::int64_t millionths = 0;

    friend bool operator==(const Decimal&, const Decimal&) = default;
};

/// The number that fills the text: an optional minus, at most nine digits, and with a point at most six more. Nothing
/// for anything else.
[[nodiscard]] std::optional<Decimal> readDecimal(std::string_view text);

/// Its shortest text: 59.9, -0.5, 60.
[[nodiscard]] std::string decimalText(Decimal number);

/// How many points sweepPoints gives. @param step not 0 and towards the end.
[[nodiscard]] std::uint64_t countPoints(Decimal from, Decimal to, Decimal step);

/// The numbers from the first to the last, a step apart. Both ends belong to them: where the step does not meet the
/// last one exactly, the way to it is shorter.
[[nodiscard]] std::vector<std::string> sweepPoints(Decimal from, Decimal to, Decimal step);

}  // namespace kdx::scenario
