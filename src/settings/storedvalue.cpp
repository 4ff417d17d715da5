#include "settings/storedvalue.h"

#include <algorithm>
#include <cmath>
#include <limits>
#include <string>

#include "base/codepage.h"
#include "base/numbers.h"
#include "settings/profilelines.h"

namespace kdx {

namespace {

/// The leading number in single precision; infinite where that cannot hold it.
float singleNumber(std::string_view text) {
    const double number = leadingNumber(text);
    if (std::abs(number) > std::numeric_limits<float>::max()) {
        return std::copysign(std::numeric_limits<float>::infinity(), static_cast<float>(std::copysign(1.0, number)));
    }
    return static_cast<float>(number);
}

}  // namespace

int storedOption(std::string_view text, int first, int last) {
    for (int option = first; option <= last; ++option) {
        if (text == std::to_string(option)) return option - first;
    }
    return -1;
}

int storedNumber(std::string_view text, int first, int last) {
    const double number = leadingNumber(text);
    for (int option = first; option <= last; ++option) {
        if (number == option) return option - first;
    }
    return -1;
}

int storedEntry(std::string_view text, int count) {
    const double number = leadingNumber(text);
    return number >= 0 && number < count ? static_cast<int>(number) : -1;
}

std::string storedFlag(std::string_view text) {
    return text == "1" ? "1" : "0";
}

bool isSwitchedOn(std::string_view text) {
    return leadingNumber(text) == 1;
}

bool opensAtStart(std::string_view text) {
    return equalNoCase(text, "AUTO");
}

std::string quotedWhereNeeded(const std::string& text) {
    if (text.empty()) return text;
    const bool blank = text.front() == ' ' || text.back() == ' ';
    const bool quote = text.front() == text.back() && (text.front() == '"' || text.front() == '\'');
    return blank || quote ? '"' + text + '"' : text;
}

int storedPosition(std::string_view text, int lowest, int highest) {
    const double within = std::clamp(leadingNumber(text), static_cast<double>(lowest), static_cast<double>(highest));
    return static_cast<int>(std::lround(within));
}

std::optional<std::string> decimalNumber(std::string_view text) {
    std::string number(trimmed(text));
    std::replace(number.begin(), number.end(), ',', '.');
    std::string_view digits = number;
    if (digits.starts_with('-') || digits.starts_with('+')) digits.remove_prefix(1);
    const std::size_t point = digits.find('.');
    const std::string_view whole = digits.substr(0, point);
    const std::string_view decimals = point == std::string_view::npos ? "0" : digits.substr(point + 1);
    return isDecimal(whole) && isDecimal(decimals) ? std::optional(number) : std::nullopt;
}

bool liesBetween(std::string_view entered, std::string_view lower, std::string_view upper) {
    const float number = singleNumber(entered);
    return number > singleNumber(lower) && number < singleNumber(upper);
}

}  // namespace kdx
