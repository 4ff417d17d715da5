#pragma once

#include <complex>
#include <optional>
#include <span>
#include <vector>

namespace kdx::air {

/// The complex amplitude of a frequency: cos(2 pi f t) has 1. Frequencies some hertz away do not count.
[[nodiscard]] std::complex<double> amplitudeOf(std::span<const float> samples, double frequency, int rate);

/// The power of samples beside a range of frequencies, against that within, in decibels.
[[nodiscard]] double decibelsBeside(std::span<const float> samples, double lowest, double highest, int rate);

/// What a receiver makes of a multiplex: mixes 57 kHz down, integrates over halves of bits where most comes out, and
/// finds the phase. The first bit is missing: without one before it, it could be either.
/// @param axis the data's phase in degrees against the third harmonic of the pilot, when it is not to be found.
[[nodiscard]] std::vector<bool> dataBits(std::span<const float> samples, int rate, std::optional<double> axis = {});

}  // namespace kdx::air
