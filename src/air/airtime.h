#pragma once

#include <chrono>
#include <cstdint>
#include <optional>
#include <ratio>
#include <string_view>

namespace kdx {
class Clock;
}

namespace kdx::air {

/// The sixteenth part of a bit of 1187.5 bit/s (IEC 62106, 4.5): bits and milliseconds are both whole numbers of it.
using Ticks = std::chrono::duration<std::int64_t, std::ratio<1, 19000>>;
/// A time of the clock that the instrument runs by.
using AirTime = std::chrono::sys_time<Ticks>;

inline constexpr int kBitsOfGroup = 104;
inline constexpr Ticks kBitTime{16};
inline constexpr Ticks kGroupTime = kBitsOfGroup * kBitTime;

/// What the clock shows now, to the millisecond.
[[nodiscard]] AirTime airTimeOf(const Clock& clock);

/// Reads "2026-01-01 12:00:00"; nothing when that is no time, or not of 2000 to 2099, the years that the coder knows.
[[nodiscard]] std::optional<AirTime> parseAirTime(std::string_view text);

}  // namespace kdx::air
