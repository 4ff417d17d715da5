#include "onair/spectrum.h"

#include <liquid/liquid.h>

#include <algorithm>
#include <cmath>
#include <numbers>

namespace kdx {

namespace {

constexpr std::size_t kSize = 4096;
constexpr double kHertzOfOne = 100000;  // what a sample of 1 is
constexpr double kHertzOfZeroDecibel = 75000;
constexpr double kNewest = 0.15;              // weight of the newest transform in the average: calm, but not slow
constexpr std::size_t kGroupsOfASecond = 12;  // rounded up

}  // namespace

Spectrum::Spectrum()
    : m_window(kSize),
      m_in(kSize),
      m_out(kSize),
      m_plan(fft_create_plan(kSize, m_in.data(), m_out.data(), LIQUID_FFT_FORWARD, 0)),
      m_power(static_cast<std::size_t>(kHighestHertz / hertzOfStep()) + 1) {
    // Side lobes must not hide the gap between the parts of the multiplex.
    for (std::size_t i = 0; i < kSize; ++i) {
        const double turn = 2 * std::numbers::pi * static_cast<double>(i) / kSize;
        m_window[i] = static_cast<float>(0.42 - 0.5 * std::cos(turn) + 0.08 * std::cos(2 * turn));
    }
    m_samples.reserve(kSize);
}

Spectrum::~Spectrum() {
    fft_destroy_plan(m_plan);
}

double Spectrum::hertzOfStep() {
    return static_cast<double>(air::kMultiplexRate) / kSize;
}

void Spectrum::take(const air::Sent& sent) {
    double peak = 0;
    for (const float sample : m_multiplex.add(sent.what, *sent.settings)) {
        peak = std::max(peak, std::abs(static_cast<double>(sample)));
        m_samples.push_back(sample);
        if (m_samples.size() == kSize) transform();
    }
    m_peaks.push_back(peak);
    if (m_peaks.size() > kGroupsOfASecond) m_peaks.pop_front();
}

void Spectrum::transform() {
    for (std::size_t i = 0; i < kSize; ++i) m_in[i] = m_samples[i] * m_window[i];
    m_samples.clear();
    fft_execute(m_plan);
    for (std::size_t i = 0; i < m_power.size(); ++i)
        m_power[i] += kNewest * (static_cast<double>(std::norm(m_out[i])) - m_power[i]);
}

std::vector<double> Spectrum::decibels() const {
    // A tone of amplitude 1 comes out as half the sum of the window.
    constexpr double kMeanOfWindow = 0.42;
    constexpr double kOfZeroDecibel = kHertzOfZeroDecibel / kHertzOfOne * kMeanOfWindow * kSize / 2;
    std::vector<double> levels;
    levels.reserve(m_power.size());
    for (const double power : m_power) {
        const double level = power > 0 ? 10 * std::log10(power / (kOfZeroDecibel * kOfZeroDecibel)) : kLowestDecibel;
        levels.push_back(std::max(level, kLowestDecibel));
    }
    return levels;
}

double Spectrum::peakHertz() const {
    return m_peaks.empty() ? 0 : kHertzOfOne * *std::max_element(m_peaks.begin(), m_peaks.end());
}

}  // namespace kdx
