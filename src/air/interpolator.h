#pragma once

#include <array>
#include <cstddef>
#include <vector>

#include "air/mixer.h"

namespace kdx::air {

/// Makes samples of the data signal, which has only one a tick.
class Interpolator {
public:
    /// Ticks that a sample is made of: from kTicksBefore before the one that it follows on.
    static constexpr std::size_t kTaps = 10;
    static constexpr std::size_t kTicksBefore = kTaps / 2 - 1;

    explicit Interpolator(int rate);

    [[nodiscard]] std::size_t ticksOfBlock() const { return m_ticks.size(); }
    /// @param ticks from kTicksBefore before the block on, kTaps - 1 more than the block has.
    [[nodiscard]] Block block(const float* ticks) const;

private:
    static constexpr std::size_t kMostSamples = 12;  ///< that follow a tick, at the higher rate
    using Samples = std::array<float, kMostSamples>;
    struct Tick {
        std::size_t firstSample = 0;
        std::array<Samples, kTaps> weights{};
    };
    std::vector<Tick> m_ticks;
};

}  // namespace kdx::air
