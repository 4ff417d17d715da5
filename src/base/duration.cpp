#include "base/duration.h"

#include <algorithm>
#include <array>
#include <cmath>

#include "base/numbers.h"

namespace kdx {

namespace {

struct Unit {
    std::string_view name;
    double milliseconds;
};
constexpr std::array kUnits = {Unit{"ms", 1}, Unit{"s", 1000}, Unit{"min", 60'000}, Unit{"h", 3'600'000}};

}  // namespace

std::optional<std::chrono::milliseconds> parseDuration(std::string_view text) {
    constexpr std::string_view kBlanks = " \t";
    const std::size_t begin = text.find_first_not_of(kBlanks);
    if (begin == std::string_view::npos) return std::nullopt;
    text = text.substr(begin, text.find_last_not_of(kBlanks) + 1 - begin);
    const std::size_t numberEnd = text.find_first_not_of("0123456789.");
    if (numberEnd == 0 || numberEnd == std::string_view::npos) return std::nullopt;
    const std::string_view number = text.substr(0, numberEnd);
    const std::size_t point = number.find('.');
    const bool onePoint = point == std::string_view::npos || number.find('.', point + 1) == std::string_view::npos;
    if (!onePoint || number == ".") return std::nullopt;
    const std::size_t unitBegin = text.find_first_not_of(kBlanks, numberEnd);
    const auto* const unit = std::find_if(kUnits.begin(), kUnits.end(),
                                          [&](const Unit& known) { return known.name == text.substr(unitBegin); });
    if (unit == kUnits.end()) return std::nullopt;
    constexpr auto kMost = static_cast<double>(std::chrono::milliseconds(kLongestDuration).count());
    const double milliseconds = std::min(leadingNumber(number) * unit->milliseconds, kMost);
    return std::chrono::milliseconds(std::llround(milliseconds));
}

}  // namespace kdx
