#pragma once

#include <cstddef>

namespace kdx {

/// Characters of a programme service name as the coder transmits it.
inline constexpr std::size_t kPsLength = 8;

/// Hexadecimal digits of a programme identification.
inline constexpr std::size_t kPiLength = 4;

}  // namespace kdx
