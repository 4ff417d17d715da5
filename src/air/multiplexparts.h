#pragma once

namespace kdx::sim {
struct InstrumentSettings;
}

namespace kdx::air {

/// What the coder's settings make of the multiplex: deviations and frequencies in hertz, phases in degrees.
struct MultiplexParts {
    double pilotDeviation = 0;
    double pilotDegrees = 0;  ///< ahead of the subcarrier of 38 kHz
    double rdsDeviation = 0;  ///< the greatest peak of the data signal, whether data are sent or not
    double rdsDegrees = 0;    ///< ahead of the subcarrier's 57 kHz, as ARI's carrier is not
    double ariDeviation = 0;  ///< of the bare carrier
    double areaFrequency = 0;
    double areaDepth = 0;
    double announcementDepth = 0;
    double toneFrequency = 0;
    // Peaks of the tone in each channel, and of its lower octave in the right one.
    double left = 0;
    double right = 0;
    double rightOctave = 0;

    friend bool operator==(const MultiplexParts&, const MultiplexParts&) = default;
};

/// ARI's announcement tone.
inline constexpr double kAnnouncementFrequency = 125;

[[nodiscard]] MultiplexParts multiplexParts(const sim::InstrumentSettings& settings);

}  // namespace kdx::air
