#pragma once

#include <cstddef>
#include <string>

#include "stereo/settings.h"

namespace kdx {

/// One deviation of the multiplex signal: its range and steps (units of 10 Hz), how it is written, sent and kept.
struct Deviation {
    int highest;         ///< in units of 10 Hz; the lowest is 0
    int step;            ///< small and large step, in units of 10 Hz
    std::size_t digits;  ///< length of the stored and sent text
    int decimals;        ///< of the kilohertz shown
    Setting setting;
};

inline constexpr Deviation kTotalDeviation{8000, 10, 5, 1, setting::kTotalDeviation};
inline constexpr Deviation kPilotDeviation{1500, 5, 4, 2, setting::kPilotDeviation};
inline constexpr Deviation kRdsDeviation{400, 5, 4, 2, setting::kRdsDeviation};
inline constexpr Deviation kAriDeviation{800, 5, 4, 2, setting::kAriDeviation};

/// The text stored and sent for a deviation: zeros in front, the rightmost `deviation.digits` characters (350 gives
/// 0350). @param tensOfHertz 0 and up.
[[nodiscard]] std::string deviationSetting(const Deviation& deviation, int tensOfHertz);

/// The deviation as shown, without its caption: kilohertz with the deviation's decimals and the unit (8000 gives
/// "80.0 kHz"). Halves are rounded up. @param tensOfHertz 0 and up.
[[nodiscard]] std::string deviationText(const Deviation& deviation, int tensOfHertz);

/// Range of the pilot phase, in degrees.
inline constexpr int kLowestPilotPhase = -4;
inline constexpr int kHighestPilotPhase = 5;

/// The text stored and sent for the pilot phase: the rightmost two characters of "00" and the number (5 gives 05, -4
/// gives -4).
[[nodiscard]] std::string pilotPhaseSetting(int degrees);

}  // namespace kdx
