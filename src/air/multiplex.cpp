#include "air/multiplex.h"

#include <algorithm>
#include <cmath>
#include <numbers>

#include "air/kaiser.h"

namespace kdx::air {

namespace {

constexpr int kTickRate = Ticks::period::den;
constexpr Ticks kFade{95};  // 5 ms
// The data signal ends at 2.4 kHz, so its images, around 19 kHz, are 115 dB down with ten ticks a sample.
constexpr double kInterpolationBeta = 11.7;

double sinc(double x) {
    return x == 0 ? 1 : std::sin(std::numbers::pi * x) / (std::numbers::pi * x);
}

}  // namespace

Multiplex::Multiplex(int rate)
    : m_rate(rate), m_ticksOfBlock(kBlockSamples * kTickRate / static_cast<std::size_t>(rate)) {
    constexpr double kReach = kTaps / 2.0;
    for (std::size_t at = 0; at < kBlockSamples; ++at) {
        const double tick = static_cast<double>(at * m_ticksOfBlock % kBlockSamples) / kBlockSamples;
        for (std::size_t tap = 0; tap < kTaps; ++tap) {
            const double distance = tick + kReach - 1 - static_cast<double>(tap);
            m_weights.at(at).at(tap) =
                static_cast<float>(sinc(distance) * kaiser(distance / kReach, kInterpolationBeta));
        }
    }
    m_tickAt = Baseband::kDelay.count() - (kTaps / 2 - 1);
}

std::span<const float> Multiplex::add(const OnAir& sent, const sim::InstrumentSettings& settings) {
    m_baseband.add(sent, m_ticks);
    m_samples.clear();
    const MultiplexParts parts = multiplexParts(settings);
    // Data are there at once and whole, so what makes room for them has faded before their first pulse.
    const bool startsData = sent.kind != OnAir::Kind::Nothing && !m_hasData;
    m_hasData = sent.kind != OnAir::Kind::Nothing;
    const auto lead = startsData ? (kFade + 2 * kBitTime).count() : 0;
    for (; m_tickAt + m_ticksOfBlock + kTaps - 1 <= m_ticks.size(); m_tickAt += m_ticksOfBlock) {
        if (m_blockTime + lead >= m_groupTime) applySettings(parts);
        addBlock();
        m_blockTime += static_cast<std::int64_t>(m_ticksOfBlock);
    }
    m_groupTime += kGroupTime.count();
    m_ticks.erase(m_ticks.begin(), m_ticks.begin() + static_cast<std::ptrdiff_t>(m_tickAt));
    m_tickAt = 0;
    return m_samples;
}

void Multiplex::applySettings(const MultiplexParts& parts) {
    if (m_mixer && m_mixer->parts() == parts) return;
    m_before = m_mixer;
    m_mixer.emplace(parts, m_rate);
    if (m_before) m_mixer->goOnFrom(*m_before);
    m_fadedSamples = 0;
}

Block Multiplex::dataSignal() const {
    Block block;
    for (std::size_t at = 0; at < kBlockSamples; ++at) {
        const float* ticks = &m_ticks[m_tickAt + at * m_ticksOfBlock / kBlockSamples];
        float sum = 0;
        for (std::size_t tap = 0; tap < kTaps; ++tap) sum += m_weights[at][tap] * ticks[tap];
        block[at] = sum;
    }
    return block;
}

void Multiplex::addBlock() {
    const Block data = dataSignal();
    Block block = m_mixer->next(data);
    if (m_before) {
        const Block before = m_before->next(data);
        const auto length = static_cast<float>(m_rate) * kFade.count() / kTickRate;
        for (std::size_t at = 0; at < kBlockSamples; ++at, ++m_fadedSamples) {
            const float faded = std::min(static_cast<float>(m_fadedSamples) / length, 1.0F);
            block[at] = before[at] + (block[at] - before[at]) * faded;
        }
        if (static_cast<float>(m_fadedSamples) >= length) m_before.reset();
    }
    m_samples.insert(m_samples.end(), block.begin(), block.end());
}

}  // namespace kdx::air
