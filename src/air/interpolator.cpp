#include "air/interpolator.h"

#include <algorithm>
#include <cmath>
#include <numbers>

#include "air/airtime.h"
#include "air/kaiser.h"

namespace kdx::air {

namespace {

// The data signal ends at 2.4 kHz, so its images, around 19 kHz, are 115 dB down with ten ticks a sample.
constexpr double kBeta = 11.7;

/// How much a sample has of a tick so many ticks away.
double weightAt(double distance) {
    constexpr double kReach = Interpolator::kTaps / 2.0;
    if (distance == 0) return 1;
    const double angle = std::numbers::pi * distance;
    return std::sin(angle) / angle * kaiser(distance / kReach, kBeta);
}

}  // namespace

Interpolator::Interpolator(int rate) : m_ticks(kBlockSamples * Ticks::period::den / static_cast<std::size_t>(rate)) {
    const auto samplesOfTick = static_cast<double>(kBlockSamples) / static_cast<double>(m_ticks.size());
    for (std::size_t at = 0; at < m_ticks.size(); ++at) {
        Tick& tick = m_ticks[at];
        tick.firstSample = (at * kBlockSamples + m_ticks.size() - 1) / m_ticks.size();
        for (std::size_t tap = 0; tap < kTaps; ++tap) {
            const double place = static_cast<double>(at + tap) - kTicksBefore;
            for (std::size_t sample = 0; sample < kMostSamples; ++sample) {
                const double time = static_cast<double>(tick.firstSample + sample) / samplesOfTick;
                tick.weights.at(tap).at(sample) = static_cast<float>(weightAt(time - place));
            }
        }
    }
}

Block Interpolator::block(const float* ticks) const {
    // Always as many samples as the compiler can work on at once; what is too many the next tick's overwrite.
    std::array<float, kBlockSamples + kMostSamples> samples;
    for (const Tick& tick : m_ticks) {
        Samples sums{};
        for (std::size_t tap = 0; tap < kTaps; ++tap) {
            for (std::size_t at = 0; at < kMostSamples; ++at) sums[at] += tick.weights[tap][at] * ticks[tap];
        }
        std::copy(sums.begin(), sums.end(), samples.begin() + static_cast<std::ptrdiff_t>(tick.firstSample));
        ++ticks;
    }
    Block block;
    std::copy_n(samples.begin(), kBlockSamples, block.begin());
    return block;
}

}  // namespace kdx::air
