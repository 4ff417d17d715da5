#include "air/multiplex.h"

#include <algorithm>

namespace kdx::air {

namespace {

constexpr int kTickRate = Ticks::period::den;
constexpr Ticks kFade{95};  // 5 ms

}  // namespace

Multiplex::Multiplex(int rate)
    : m_rate(rate),
      m_interpolator(rate),
      m_tickAt(static_cast<std::size_t>(Baseband::kDelay.count()) - Interpolator::kTicksBefore) {}

std::span<const float> Multiplex::add(const OnAir& sent, const sim::InstrumentSettings& settings) {
    m_baseband.add(sent, m_ticks);
    m_samples.clear();
    const MultiplexParts parts = multiplexParts(settings);
    // Data are there at once and whole, so what makes room for them has faded before their first pulse.
    const bool startsData = sent.kind != OnAir::Kind::Nothing && !m_hasData;
    m_hasData = sent.kind != OnAir::Kind::Nothing;
    const auto lead = startsData ? (kFade + 2 * kBitTime).count() : 0;
    const std::size_t ticksOfBlock = m_interpolator.ticksOfBlock();
    for (; m_tickAt + ticksOfBlock + Interpolator::kTaps - 1 <= m_ticks.size(); m_tickAt += ticksOfBlock) {
        if (m_blockTime + lead >= m_groupTime) applySettings(parts);
        addBlock();
        m_blockTime += static_cast<std::int64_t>(ticksOfBlock);
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

void Multiplex::addBlock() {
    const Block data = m_interpolator.block(&m_ticks[m_tickAt]);
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
