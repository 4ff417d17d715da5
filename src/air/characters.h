#pragma once

#include <cstdint>
#include <span>
#include <string>
#include <string_view>

#include "air/warnings.h"

namespace kdx::air {

/// Writes a text of the Windows-1252 code page in codes of the basic character set (IEC 62106, annex E), blanks behind
/// it. A character without a place there becomes a blank, which is told.
/// @param name whose text it is, for the warning.
void writeCodes(std::string_view text, std::span<std::uint8_t> codes, const std::string& name, Warnings& warnings);

/// Two characters as a block holds them.
[[nodiscard]] constexpr std::uint16_t pairOf(unsigned high, unsigned low) {
    return static_cast<std::uint16_t>(high << 8U | low);
}

}  // namespace kdx::air
