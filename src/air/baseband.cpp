#include "air/baseband.h"

#include <algorithm>
#include <cmath>
#include <numbers>

#include "air/kaiser.h"

namespace kdx::air {

namespace {

constexpr std::size_t kTicksOfBit = kBitTime.count();
constexpr int kBitsOfByte = 8;
// With the pulse's length this keeps what is beyond 2.4 kHz 110 dB down.
constexpr double kPulseBeta = 5;

/// What the filter of IEC 62106, 4.7, cos(pi f / 4) up to 2 a bit, makes of an impulse. @param time in bits.
double filtered(double time) {
    const double x = 8 * time;
    if (std::abs(std::abs(x) - 1) < 1e-9) return std::numbers::pi / 4;
    return std::cos(std::numbers::pi / 2 * x) / (1 - x * x);
}

std::array<std::uint8_t, kBytesOfGroup> dataOf(const OnAir& sent) {
    if (sent.kind == OnAir::Kind::Group) return bitsOf(sent.group);
    std::array<std::uint8_t, kBytesOfGroup> bytes{};
    bytes.fill(sent.pattern);
    return bytes;
}

}  // namespace

Baseband::Baseband() = default;

/// An impulse for the first half of the bit and its opposite for the second, in the middle of the array.
Baseband::Pulse Baseband::pulse() {
    Pulse pulse{};
    std::array<double, kTicksOfBit> peaks{};
    std::array<double, kPulseTicks> exact{};
    for (std::size_t at = 0; at < kPulseTicks; ++at) {
        const double time = static_cast<double>(at) / kTicksOfBit - kPulseBits / 2.0;
        exact.at(at) = (filtered(time + 0.25) - filtered(time - 0.25)) * kaiser(time / (kPulseBits / 2.0), kPulseBeta);
        // At most all pulses that overlap add up.
        peaks.at(at % kTicksOfBit) += std::abs(exact.at(at));
    }
    const double greatest = *std::max_element(peaks.begin(), peaks.end());
    std::transform(exact.begin(), exact.end(), pulse.begin(),
                   [greatest](double value) { return static_cast<float>(value / greatest); });
    return pulse;
}

void Baseband::add(const OnAir& sent, std::vector<float>& signal) {
    const auto bytes = dataOf(sent);
    for (std::size_t bit = 0; bit < kBitsOfGroup; ++bit) {
        if (sent.kind != OnAir::Kind::Nothing) {
            const bool data = (bytes.at(bit / kBitsOfByte) >> (kBitsOfByte - 1 - bit % kBitsOfByte) & 1U) != 0;
            m_coded = m_coded != data;
            const float sign = m_coded ? 1.0F : -1.0F;
            for (std::size_t at = 0; at < kPulseTicks; ++at) m_sum[at] += sign * m_pulse[at];
        }
        signal.insert(signal.end(), m_sum.begin(), m_sum.begin() + kTicksOfBit);
        std::fill_n(std::copy(m_sum.begin() + kTicksOfBit, m_sum.end(), m_sum.begin()), kTicksOfBit, 0.0F);
    }
}

}  // namespace kdx::air
