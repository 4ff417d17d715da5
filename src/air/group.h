#pragma once

#include <array>
#include <cstddef>
#include <cstdint>
#include <string>

#include "air/airtime.h"

namespace kdx::air {

/// The types of groups that the coder sends (IEC 62106, 6.1), as the five bits that block 2 begins with.
enum class GroupType : std::uint8_t {
    Basic0A = 0,
    Basic0B = 1,
    Radiotext2A = 4,
    Radiotext2B = 5,
    OpenData3A = 6,
    Clock4A = 8,
    Traffic8A = 16,
    Networks14A = 28,
    Networks14B = 29,
    Tuning15B = 31,
};

/// The information words of the four blocks of a group.
struct Group {
    std::array<std::uint16_t, 4> blocks{};
    friend bool operator==(const Group&, const Group&) = default;
};

/// Offset words (IEC 62106, annex A): they tell the blocks apart.
enum class Offset : std::uint16_t { A = 0x0FC, B = 0x198, C = 0x168, CPrime = 0x350, D = 0x1B4 };

/// The ten bits that follow an information word: what its shortened cyclic code gives, with the offset word added.
[[nodiscard]] std::uint16_t checkWord(std::uint16_t information, Offset offset);

/// The offset word of a block, 0 to 3; the third one of a group of version B has C'.
[[nodiscard]] Offset offsetOf(const Group& group, std::size_t block);

inline constexpr std::size_t kBytesOfGroup = kBitsOfGroup / 8;
/// The group's bits as they go out, the first one in the highest bit of the first byte.
[[nodiscard]] std::array<std::uint8_t, kBytesOfGroup> bitsOf(const Group& group);

/// A line of a group log: four blocks in hexadecimal and when the group ended, to the hundredth of a second.
[[nodiscard]] std::string logLine(const Group& group, AirTime end);

}  // namespace kdx::air
