#include "base/duration.h"

#include <cmath>

#include "base/numbers.h"

namespace kdx {

std::optional<std::chrono::milliseconds> parseDuration(std::string_view text) {
    constexpr std::string_view kBlanks = " \t";
    constexpr double kDay = 86'400'000;
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
    const std::string_view unit = text.substr(unitBegin);
    if (unit != "s" && unit != "ms") return std::nullopt;
    const double milliseconds = leadingNumber(number) * (unit == "s" ? 1000 : 1);
    if (milliseconds > kDay) return std::nullopt;
    return std::chrono::milliseconds(std::llround(milliseconds));
}

}  // namespace kdx
