#pragma once

#include <complex>
#include <cstddef>
#include <deque>
#include <memory>
#include <span>
#include <vector>

#include "air/multiplex.h"
#include "air/shadow.h"

struct fftplan_s;

namespace kdx {

/// The spectrum of the multiplex from 0 to 60 kHz, and what it peaks at, as it goes out.
class Spectrum {
public:
    static constexpr double kHighestHertz = 60000;
    static constexpr double kLowestDecibel = -100;

    Spectrum();
    ~Spectrum();
    Spectrum(const Spectrum&) = delete;
    Spectrum& operator=(const Spectrum&) = delete;

    /// Takes what went out for the length of a group.
    void take(const air::Sent& sent);

    /// Levels from 0 Hz on, each hertzOfStep() further: 0 dB is a tone of 75 kHz deviation.
    [[nodiscard]] std::vector<double> decibels() const;
    [[nodiscard]] static double hertzOfStep();
    /// What the last second peaked at.
    [[nodiscard]] double peakHertz() const;

private:
    void transform();

    air::Multiplex m_multiplex{air::kMultiplexRate};
    std::vector<float> m_window;
    std::vector<float> m_samples;  ///< those of the next transform
    std::vector<std::complex<float>> m_in;
    std::vector<std::complex<float>> m_out;
    fftplan_s* m_plan;            ///< owned; the library takes it back
    std::vector<double> m_power;  ///< of each step, averaged
    std::deque<double> m_peaks;   ///< of the last groups
};

}  // namespace kdx
