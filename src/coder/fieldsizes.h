#pragma once

#include <cstddef>

namespace kdx {

/// Characters of a programme service name as the coder transmits it.
inline constexpr std::size_t kPsLength = 8;

/// Hexadecimal digits of a programme identification.
inline constexpr std::size_t kPiLength = 4;

inline constexpr std::size_t kRadiotextLength = 64;

/// Hexadecimal digits of a message of group 3A or 8A.
inline constexpr std::size_t kGroupDigits = 10;

/// A group sequence holds so many groups at most, each from 0A to 15B.
inline constexpr std::size_t kMostGroups = 256;
inline constexpr int kHighestGroup = 15;

}  // namespace kdx
