#pragma once

#include <array>
#include <cstddef>
#include <vector>

#include "air/airtime.h"
#include "air/composer.h"

namespace kdx::air {

/// The data signal that is modulated upon 57 kHz (IEC 62106, 4.6 and 4.7): differential code, biphase symbols,
/// cosine roll-off. A sample a tick; 1 is the greatest peak that any data can make.
class Baseband {
public:
    /// How much later than the bits their signal comes.
    static constexpr Ticks kDelay{248};

    Baseband();

    /// Appends a group's time of signal.
    void add(const OnAir& sent, std::vector<float>& signal);

private:
    static constexpr std::size_t kPulseBits = 32;
    static constexpr std::size_t kPulseTicks = kPulseBits * kBitTime.count();
    using Pulse = std::array<float, kPulseTicks>;
    [[nodiscard]] static Pulse pulse();

    Pulse m_pulse = pulse();  ///< what a 1 makes
    Pulse m_sum{};            ///< of the pulses so far, from the next sample on
    bool m_coded = false;     ///< the last bit in differential code
};

}  // namespace kdx::air
