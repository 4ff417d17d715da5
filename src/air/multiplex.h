#pragma once

#include <cstddef>
#include <cstdint>
#include <optional>
#include <span>
#include <vector>

#include "air/airtime.h"
#include "air/baseband.h"
#include "air/composer.h"
#include "air/interpolator.h"
#include "air/mixer.h"

namespace kdx::air {

/// Sample rates that a period of every carrier divides evenly.
inline constexpr int kMultiplexRate = 228000;
inline constexpr int kLowMultiplexRate = 192000;

/// The stereo multiplex, sample by sample; 1 is a deviation of 100 kHz. The first bit begins with the first sample.
class Multiplex {
public:
    /// @param rate one of the two.
    explicit Multiplex(int rate);

    /// Sends something for the length of a group, with the settings that hold meanwhile; what they change fades over.
    /// @returns the samples that this makes complete, valid until the next call. They are some 13 ms behind, as the
    /// pulse of a bit begins before the bit does.
    std::span<const float> add(const OnAir& sent, const sim::InstrumentSettings& settings);

private:
    void applySettings(const MultiplexParts& parts);
    void addBlock();

    int m_rate;
    Interpolator m_interpolator;
    Baseband m_baseband;
    std::vector<float> m_ticks;    ///< the data signal, from what the next block needs on
    std::size_t m_tickAt;          ///< where that is
    std::int64_t m_blockTime = 0;  ///< ticks up to the next block
    std::int64_t m_groupTime = 0;  ///< ticks up to the next group
    bool m_hasData = false;
    std::optional<Mixer> m_mixer;
    std::optional<Mixer> m_before;  ///< while it fades
    std::size_t m_fadedSamples = 0;
    std::vector<float> m_samples;
};

}  // namespace kdx::air
