#include "settings/storedvalue.h"

#include <algorithm>
#include <cmath>
#include <limits>
#include <string>

#include "base/numbers.h"

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

bool liesBetween(std::string_view entered, std::string_view lower, std::string_view upper) {
    const float number = singleNumber(entered);
    return number > singleNumber(lower) && number < singleNumber(upper);
}

}  // namespace kdx
