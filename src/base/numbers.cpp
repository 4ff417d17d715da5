#include "base/numbers.h"

#include <algorithm>
#include <array>
#include <charconv>
#include <cmath>
#include <cstdint>
#include <limits>

namespace kdx {

namespace {

bool isDigit(char c) {
    return c >= '0' && c <= '9';
}

std::size_t digitsEnd(std::string_view text, std::size_t from) {
    while (from < text.size() && isDigit(text[from])) ++from;
    return from;
}

/// Whether a number that no double can hold is too large; else it is too small. The power of ten of its first digit
/// that is not 0 tells.
bool isTooLarge(std::string_view number) {
    const std::size_t mark = std::min(number.find_first_of("eE"), number.size());
    const std::string_view digits = number.substr(0, mark);
    const auto point = static_cast<std::int64_t>(std::min(digits.find('.'), digits.size()));
    const auto first = static_cast<std::int64_t>(digits.find_first_of("123456789"));
    std::string_view power = number.substr(std::min(mark + 1, number.size()));
    if (power.starts_with('+')) power.remove_prefix(1);
    std::int64_t exponent = 0;
    const auto result = std::from_chars(power.data(), power.data() + power.size(), exponent);
    if (result.ec == std::errc::result_out_of_range) return !power.starts_with('-');
    return exponent > first - point;
}

std::string format(double value, std::chars_format form, int precision) {
    std::array<char, 400> buffer{};  // the longest double in fixed form has 309 digits before the point
    const auto result = std::to_chars(buffer.data(), buffer.data() + buffer.size(), value, form, precision);
    return {buffer.data(), result.ptr};
}

}  // namespace

double leadingNumber(std::string_view text) {
    std::size_t start = 0;
    while (start < text.size() && (text[start] == ' ' || text[start] == '\t')) ++start;
    bool negative = false;
    if (start < text.size() && (text[start] == '+' || text[start] == '-')) {
        negative = text[start] == '-';
        ++start;
    }
    std::size_t end = digitsEnd(text, start);
    bool anyDigit = end > start;
    if (end < text.size() && text[end] == '.') {
        const std::size_t fractionEnd = digitsEnd(text, end + 1);
        anyDigit = anyDigit || fractionEnd > end + 1;
        end = fractionEnd;
    }
    if (!anyDigit) return 0.0;
    if (end < text.size() && (text[end] == 'e' || text[end] == 'E')) {
        std::size_t exponent = end + 1;
        if (exponent < text.size() && (text[exponent] == '+' || text[exponent] == '-')) ++exponent;
        const std::size_t exponentEnd = digitsEnd(text, exponent);
        if (exponentEnd > exponent) end = exponentEnd;
    }
    double value = 0.0;
    const std::string_view number = text.substr(start, end - start);
    const auto result = std::from_chars(number.data(), number.data() + number.size(), value);
    if (result.ec == std::errc::result_out_of_range) {
        value = isTooLarge(number) ? std::numeric_limits<double>::infinity() : 0.0;
    }
    return negative ? -value : value;
}

bool isDecimal(std::string_view text) {
    return !text.empty() && digitsEnd(text, 0) == text.size();
}

bool isHex(std::string_view text) {
    return !text.empty() && text.find_first_not_of("0123456789abcdefABCDEF") == std::string_view::npos;
}

std::string shortestDecimal(double value) {
    if (value == 0.0) return "0";  // also for -0, which has no text of its own
    // 15 digits hide the last bit's noise: 67.6 * 10 is 676, not 676.0000000000001.
    std::array<char, 64> general{};
    const auto written =
        std::to_chars(general.data(), general.data() + general.size(), value, std::chars_format::general, 15);
    const std::string_view text(general.data(), static_cast<std::size_t>(written.ptr - general.data()));
    double rounded = value;
    std::from_chars(text.data(), text.data() + text.size(), rounded);
    std::array<char, 400> buffer{};
    const bool plain = std::abs(rounded) < 1e15 && std::abs(rounded) >= 1e-15;
    const auto result = std::to_chars(buffer.data(), buffer.data() + buffer.size(), rounded,
                                      plain ? std::chars_format::fixed : std::chars_format::scientific);
    return {buffer.data(), result.ptr};
}

std::string fixedDecimal(double value, int decimals) {
    return format(value, std::chars_format::fixed, decimals);
}

std::string twoDigits(int number) {
    return rightmost("0" + std::to_string(number), 2);
}

std::string hexDigits(unsigned value, unsigned count) {
    constexpr std::string_view kDigits = "0123456789ABCDEF";
    std::string digits;
    for (unsigned i = count; i > 0; --i) digits += kDigits[value >> (4 * (i - 1)) & 0xFU];
    return digits;
}

std::string rightmost(std::string_view text, std::size_t count) {
    return std::string(text.size() > count ? text.substr(text.size() - count) : text);
}

std::string padRight(std::string_view text, std::size_t width) {
    std::string field(text.substr(0, width));
    field.resize(width, ' ');
    return field;
}

}  // namespace kdx
