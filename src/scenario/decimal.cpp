#include "scenario/decimal.h"

#include <algorithm>
#include <cstdlib>

#include "base/numbers.h"

namespace kdx::scenario {

namespace {

constexpr std::size_t kMostDigits = 9;
constexpr std::size_t kDecimals = 6;

std::int64_t number(std::string_view digits) {
    std::int64_t value = 0;
    for (const char digit : digits) value = value * 10 + (digit - '0');
    return value;
}

}  // namespace

std::optional<Decimal> readDecimal(std::string_view text) {
    const bool negative = text.starts_with('-');
    if (negative) text.remove_prefix(1);
    const std::size_t point = text.find('.');
    const std::string_view whole = text.substr(0, point);
    if (!isDecimal(whole) || whole.size() > kMostDigits) return std::nullopt;
    std::int64_t value = number(whole) * Decimal::kOne;
    if (point != std::string_view::npos) {
        std::string decimals(text.substr(point + 1));
        if (!isDecimal(decimals) || decimals.size() > kDecimals) return std::nullopt;
        decimals.resize(kDecimals, '0');
        value += number(decimals);
    }
    return Decimal{negative ? -value : value};
}

std::string decimalText(Decimal number) {
    const std::int64_t size = std::abs(number.millionths);
    std::string text = (number.millionths < 0 ? "-" : "") + std::to_string(size / Decimal::kOne);
    if (size % Decimal::kOne == 0) return text;
    const std::string decimals = std::to_string(size % Decimal::kOne);
    text.append(".").append(kDecimals - decimals.size(), '0').append(decimals);
    text.erase(text.find_last_not_of('0') + 1);
    return text;
}

std::uint64_t countPoints(Decimal from, Decimal to, Decimal step) {
    const auto way = static_cast<std::uint64_t>(std::abs(to.millionths - from.millionths));
    const auto one = static_cast<std::uint64_t>(std::abs(step.millionths));
    return way / one + (way % one == 0 ? 1 : 2);
}

std::vector<std::string> sweepPoints(Decimal from, Decimal to, Decimal step) {
    std::vector<std::string> points;
    const std::uint64_t count = countPoints(from, to, step);
    for (std::uint64_t i = 0; i + 1 < count; ++i)
        points.push_back(decimalText({from.millionths + static_cast<std::int64_t>(i) * step.millionths}));
    points.push_back(decimalText(to));
    return points;
}

}  // namespace kdx::scenario
