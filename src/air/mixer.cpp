#include "air/mixer.h"

#include <cmath>
#include <numbers>

namespace kdx::air {

namespace {

constexpr double kFullScale = 100000;
constexpr double kPilot = 19000;
constexpr double kTurn = 2 * std::numbers::pi;

double radians(double degrees) {
    return degrees / 360 * kTurn;
}

}  // namespace

Tone::Tone(double frequency, int rate) : m_turnsOfBlock(frequency / rate * kBlockSamples) {
    for (std::size_t at = 0; at < kBlockSamples; ++at) {
        const double angle = kTurn * frequency / rate * static_cast<double>(at);
        m_sines.at(at) = static_cast<float>(std::sin(angle));
        m_cosines.at(at) = static_cast<float>(std::cos(angle));
    }
}

Block Tone::next() {
    const auto sine = static_cast<float>(std::sin(kTurn * m_turns));
    const auto cosine = static_cast<float>(std::cos(kTurn * m_turns));
    Block block;
    for (std::size_t at = 0; at < kBlockSamples; ++at) block[at] = sine * m_cosines[at] + cosine * m_sines[at];
    m_turns += m_turnsOfBlock;
    m_turns -= std::floor(m_turns);
    return block;
}

Mixer::Mixer(const MultiplexParts& parts, int rate)
    : m_parts(parts),
      m_tone(parts.toneFrequency, rate),
      m_octave(parts.toneFrequency / 2, rate),
      m_area(parts.areaFrequency, rate),
      m_announcement(kAnnouncementFrequency, rate) {
    const auto scaled = [](double deviation) { return static_cast<float>(deviation / kFullScale); };
    for (std::size_t at = 0; at < kBlockSamples; ++at) {
        const double pilotAngle = kTurn * kPilot / rate * static_cast<double>(at);
        // The subcarrier crosses zero upwards whenever a pilot of phase 0 crosses zero (BS.450, 2.3).
        const double subcarrier = std::sin(2 * pilotAngle);
        const double thirdHarmonic = std::sin(3 * pilotAngle);
        m_toneCarrier.at(at) = scaled((parts.left + parts.right) / 2 + (parts.left - parts.right) / 2 * subcarrier);
        m_octaveCarrier.at(at) = scaled(parts.rightOctave / 2 * (1 - subcarrier));
        m_areaCarrier.at(at) = scaled(parts.ariDeviation * parts.areaDepth * thirdHarmonic);
        m_announcementCarrier.at(at) = scaled(parts.ariDeviation * parts.announcementDepth * thirdHarmonic);
        m_dataCarrier.at(at) = scaled(parts.rdsDeviation * std::sin(3 * pilotAngle + radians(parts.rdsDegrees)));
        m_carriers.at(at) = scaled(parts.pilotDeviation * std::sin(pilotAngle + radians(parts.pilotDegrees)) +
                                   parts.ariDeviation * thirdHarmonic);
    }
}

Block Mixer::next(const Block& data) {
    const Block tone = m_tone.next();
    const Block octave = m_octave.next();
    const Block area = m_area.next();
    const Block announcement = m_announcement.next();
    Block block;
    for (std::size_t at = 0; at < kBlockSamples; ++at) {
        block[at] = m_carriers[at] + tone[at] * m_toneCarrier[at] + octave[at] * m_octaveCarrier[at] +
                    area[at] * m_areaCarrier[at] + announcement[at] * m_announcementCarrier[at] +
                    data[at] * m_dataCarrier[at];
    }
    return block;
}

void Mixer::goOnFrom(const Mixer& other) {
    m_tone.goOnFrom(other.m_tone);
    m_octave.goOnFrom(other.m_octave);
    m_area.goOnFrom(other.m_area);
    m_announcement.goOnFrom(other.m_announcement);
}

}  // namespace kdx::air
