#pragma once

#include <string>
#include <string_view>

/// The program's shared number functions.
namespace kdx::Modul2 {

/// The number as binary digits, most significant first: 16 characters for 0 up to, but not including, 65536; a
/// fraction is left out. Larger numbers are not guarded against: the digit of 2^15 is then the decimal text of how
/// often it is contained (65536 gives "2000000000000000"), and the text has more characters where that is above 9.
/// Digits of a negative number are negative ("-1"). Infinity and NaN have no digits and give 16 times "0".
[[nodiscard]] std::string ToBinary16(float value);

/// The number whose binary digits, most significant first, are the text's characters. Each counts with its numeric
/// value ("2" twice, no digit not at all); "" gives 0.
[[nodiscard]] double BinaryToValue(std::string_view text);

}  // namespace kdx::Modul2
