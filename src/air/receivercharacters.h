#pragma once

#include <cstdint>
#include <span>
#include <string>

namespace kdx::air {

/// What a radio shows for codes of the basic character set (IEC 62106, annex E), in UTF-8, as the set has letters that
/// Windows-1252 lacks. A code without a character shows as a blank.
[[nodiscard]] std::string shownText(std::span<const std::uint8_t> codes);

}  // namespace kdx::air
