#include "air/demodulator.h"

#include <algorithm>
#include <cmath>
#include <numbers>
#include <numeric>

namespace kdx::air {

namespace {

using Complex = std::complex<double>;
constexpr double kTurn = 2 * std::numbers::pi;
constexpr double kBitRate = 1187.5;

/// Blackman-Harris: four cosines, 92 dB and more from everything else.
double windowAt(std::size_t at, std::size_t size) {
    const double turn = kTurn * static_cast<double>(at) / static_cast<double>(size);
    return 0.35875 - 0.48829 * std::cos(turn) + 0.14128 * std::cos(2 * turn) - 0.01168 * std::cos(3 * turn);
}

/// In place; the size is a power of two.
void transform(std::vector<Complex>& values) {
    const std::size_t size = values.size();
    for (std::size_t at = 1, mirrored = 0; at < size; ++at) {
        std::size_t bit = size >> 1U;
        for (; (mirrored & bit) != 0; bit >>= 1U) mirrored ^= bit;
        mirrored |= bit;
        if (at < mirrored) std::swap(values[at], values[mirrored]);
    }
    for (std::size_t length = 2; length <= size; length *= 2) {
        std::vector<Complex> turns(length / 2);
        for (std::size_t at = 0; at < turns.size(); ++at)
            turns[at] = std::polar(1.0, -kTurn * static_cast<double>(at) / static_cast<double>(length));
        for (std::size_t begin = 0; begin < size; begin += length) {
            for (std::size_t at = begin; at < begin + length / 2; ++at) {
                const Complex other = values[at + length / 2] * turns[at - begin];
                values[at + length / 2] = values[at] - other;
                values[at] += other;
            }
        }
    }
}

void average(std::vector<Complex>& values, std::size_t length) {
    Complex sum;
    std::vector<Complex> averages(values.size());
    for (std::size_t at = 0; at < values.size(); ++at) {
        sum += values[at];
        if (at >= length) sum -= values[at - length];
        averages[at] = sum / static_cast<double>(length);
    }
    values = std::move(averages);
}

/// The sums of the signal around 57 kHz, mixed down, up to each sample.
std::vector<Complex> integralOf(std::span<const float> samples, int rate) {
    constexpr int kCarrier = 57000;
    const auto period = static_cast<std::size_t>(rate / std::gcd(rate, kCarrier));
    std::vector<Complex> carrier(period);
    for (std::size_t at = 0; at < period; ++at)
        carrier[at] = std::polar(1.0, -kTurn * static_cast<double>(at) * kCarrier / rate);
    std::vector<Complex> mixed(samples.size());
    for (std::size_t at = 0; at < samples.size(); ++at)
        mixed[at] = static_cast<double>(samples[at]) * carrier[at % period];
    // Zero at 19 and at 38 kHz from the carrier, or nearly so.
    for (int stage = 0; stage < 3; ++stage) average(mixed, static_cast<std::size_t>(rate / 4750));
    std::partial_sum(mixed.begin(), mixed.end(), mixed.begin());
    return mixed;
}

Complex between(const std::vector<Complex>& integral, double at) {
    const auto before = static_cast<std::size_t>(at);
    return integral[before] + (integral[before + 1] - integral[before]) * (at - static_cast<double>(before));
}

/// First half less second half of each bit that begins a part of a bit later than the first sample.
std::vector<Complex> symbols(const std::vector<Complex>& integral, double part, double samplesOfBit) {
    std::vector<Complex> found;
    for (double begin = part * samplesOfBit; begin + samplesOfBit + 1 < static_cast<double>(integral.size());
         begin = (part + static_cast<double>(found.size())) * samplesOfBit) {
        const Complex middle = between(integral, begin + samplesOfBit / 2);
        found.push_back(2.0 * middle - between(integral, begin) - between(integral, begin + samplesOfBit));
    }
    return found;
}

double powerOf(const std::vector<Complex>& values) {
    return std::accumulate(values.begin(), values.end(), 0.0,
                           [](double sum, Complex value) { return sum + std::norm(value); });
}

}  // namespace

std::complex<double> amplitudeOf(std::span<const float> samples, double frequency, int rate) {
    Complex sum;
    double weight = 0;
    for (std::size_t at = 0; at < samples.size(); ++at) {
        const double window = windowAt(at, samples.size());
        weight += window;
        sum += static_cast<double>(samples[at]) * window *
               std::polar(1.0, -kTurn * frequency / rate * static_cast<double>(at));
    }
    return 2.0 * sum / weight;
}

double decibelsBeside(std::span<const float> samples, double lowest, double highest, int rate) {
    std::size_t size = 1;
    while (size * 2 <= samples.size()) size *= 2;
    std::vector<Complex> values(size);
    for (std::size_t at = 0; at < size; ++at)
        values[at] = static_cast<double>(samples[at]) * std::pow(windowAt(at, size), 2);
    transform(values);
    double within = 0;
    double beside = 0;
    for (std::size_t at = 0; at < size / 2; ++at) {
        const double frequency = static_cast<double>(at) * rate / static_cast<double>(size);
        (frequency >= lowest && frequency <= highest ? within : beside) += std::norm(values[at]);
    }
    return 10 * std::log10(beside / within);
}

std::vector<bool> dataBits(std::span<const float> samples, int rate, std::optional<double> axis) {
    const double samplesOfBit = rate / kBitRate;
    const std::vector<Complex> integral = integralOf(samples, rate);
    std::vector<Complex> best;
    constexpr int kClockPhases = 16;
    for (int phase = 0; phase < kClockPhases; ++phase) {
        auto tried = symbols(integral, static_cast<double>(phase) / kClockPhases, samplesOfBit);
        if (powerOf(tried) > powerOf(best)) best = std::move(tried);
    }
    Complex squares;
    for (const Complex symbol : best) squares += symbol * symbol;
    const double turned = axis ? *axis / 360 * kTurn - std::numbers::pi / 2 : std::arg(squares) / 2;
    const auto isPositive = [turned](Complex symbol) { return (symbol * std::polar(1.0, -turned)).real() > 0; };
    std::vector<bool> bits;
    for (std::size_t at = 1; at < best.size(); ++at) bits.push_back(isPositive(best[at]) != isPositive(best[at - 1]));
    return bits;
}

}  // namespace kdx::air
