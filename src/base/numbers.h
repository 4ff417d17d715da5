#pragma once

#include <string>
#include <string_view>

namespace kdx {

/// The number a text begins with: leading blanks and tabs skipped, optional sign, digits, one point, an exponent when
/// digits follow it; reading stops at the first character that does not fit. "67.5 x" gives 67.5, "87,6" gives 87,
/// "" and "abc" give 0. The point is the decimal separator whatever the locale. A number too large for a double gives
/// infinity, one too small 0.
[[nodiscard]] double leadingNumber(std::string_view text);

/// True for a text of decimal digits only (not empty).
[[nodiscard]] bool isDecimal(std::string_view text);

/// True for a text of hexadecimal digits only (not empty), in any letter case.
[[nodiscard]] bool isHex(std::string_view text);

/// The shortest decimal text that reads back as the same number, at most 15 significant digits, with a point and no
/// leading blank: 675, 2.5, -30. Numbers of 1e15 and more are written with an exponent.
[[nodiscard]] std::string shortestDecimal(double value);

/// The number with exactly the given count of decimals, a point as separator whatever the locale: (0.05, 2) gives 0.05.
[[nodiscard]] std::string fixedDecimal(double value, int decimals);

/// The last two digits of a number that is not negative: 5 gives 05, 2009 gives 09.
[[nodiscard]] std::string twoDigits(int number);

/// That many hexadecimal digits in capitals, with leading zeros: (0xD3C, 4) gives 0D3C.
[[nodiscard]] std::string hexDigits(unsigned value, unsigned count);

/// The text's last `count` characters; the whole text when it is shorter.
[[nodiscard]] std::string rightmost(std::string_view text, std::size_t count);

/// The text followed by blanks, cut to exactly `width` characters.
[[nodiscard]] std::string padRight(std::string_view text, std::size_t width);

}  // namespace kdx
