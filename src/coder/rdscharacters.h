#pragma once

#include <optional>
#include <string_view>

namespace kdx {

/// The RDS code of a character of the Windows-1252 code page in the basic character set of IEC 62106 (EN 50067),
/// annex E; nothing for a character that RDS cannot send. Of two look-alikes at 8D (beta, sharp s) it is the sharp s.
[[nodiscard]] std::optional<unsigned char> rdsCode(char character);

/// The text's first character that RDS has no code for; nothing when it has one for all.
[[nodiscard]] std::optional<char> withoutRdsCode(std::string_view text);

}  // namespace kdx
