#pragma once

#include <array>
#include <cstddef>

#include "air/multiplexparts.h"

namespace kdx::air {

/// After so many samples all carriers begin anew at both sample rates, so tables of them are exact.
inline constexpr std::size_t kBlockSamples = 192;
using Block = std::array<float, kBlockSamples>;

/// A tone, block by block.
class Tone {
public:
    Tone(double frequency, int rate);
    [[nodiscard]] Block next();
    void goOnFrom(const Tone& other) { m_turns = other.m_turns; }

private:
    Block m_sines{};  ///< how far the tone turns up to each sample
    Block m_cosines{};
    double m_turnsOfBlock;
    double m_turns = 0;
};

/// Makes the multiplex of its parts (ITU-R BS.450); 1 is a deviation of 100 kHz. The parts stay as they are: who wants
/// others fades over to another mixer.
class Mixer {
public:
    Mixer(const MultiplexParts& parts, int rate);
    [[nodiscard]] const MultiplexParts& parts() const { return m_parts; }

    /// The next samples. @param data the data signal, 1 its greatest peak.
    [[nodiscard]] Block next(const Block& data);
    /// The tones go on as the other mixer's stand.
    void goOnFrom(const Mixer& other);

private:
    MultiplexParts m_parts;
    Tone m_tone;
    Tone m_octave;
    Tone m_area;
    Tone m_announcement;
    // What each of them, and 1, is multiplied by.
    Block m_toneCarrier{};
    Block m_octaveCarrier{};
    Block m_areaCarrier{};
    Block m_announcementCarrier{};
    Block m_dataCarrier{};
    Block m_carriers{};
};

}  // namespace kdx::air
