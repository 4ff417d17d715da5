#include "air/multiplexparts.h"

#include <array>
#include <cmath>
#include <cstddef>
#include <numbers>

#include "air/deviations.h"
#include "sim/setup.h"

namespace kdx::air {

namespace {

// Choices of the instrument, which count from 1.
constexpr int kToneGenerator = 3;
enum StereoMode { Left = 1, Right, Same, Opposite, Octave };
enum AriType { Announcement = 1, Area, AreaAndAnnouncement };

constexpr double kAriCarrier = 57000;
constexpr std::array kAreaDivisors = {2400.0, 2016.0, 1632.0, 1440.0, 1248.0, 1056.0};  // of the carrier, A to F

constexpr double kHighestAudio = 15000;  // ITU-R BS.450, 2.2: the sound channels end there
constexpr std::array kPreemphasisSeconds = {50e-6, 75e-6};

/// How much the pre-emphasis lifts a frequency, against none at all.
double lift(double frequency, double timeConstant) {
    return std::hypot(1.0, 2 * std::numbers::pi * frequency * timeConstant);
}

/// Which part of the audio's share a tone has.
double shareOf(double frequency, const sim::Setup& setup) {
    if (frequency > kHighestAudio) return 0;
    if (!setup.preemphasisOn) return 1;
    const double timeConstant = kPreemphasisSeconds.at(static_cast<std::size_t>(setup.preemphasis) - 1);
    return lift(frequency, timeConstant) / lift(kHighestAudio, timeConstant);
}

void addAri(const sim::Setup& setup, MultiplexParts& parts) {
    if (!setup.ariOn) return;
    parts.ariDeviation = setup.ariHertz;
    parts.rdsDegrees += 90;
    parts.areaFrequency = kAriCarrier / kAreaDivisors.at(static_cast<std::size_t>(setup.ariArea) - 1);
    if (!setup.ariTypeOn) return;
    if (setup.ariType != Announcement) parts.areaDepth = kAreaDepth;
    if (setup.ariType != Area) parts.announcementDepth = kAnnouncementDepth;
}

void addAudio(const sim::InstrumentSettings& settings, MultiplexParts& parts) {
    if (settings.source != kToneGenerator) return;
    const double room = deviationsOf(settings).audio;
    parts.toneFrequency = settings.audioKilohertz * 1000;
    const double peak = room * shareOf(parts.toneFrequency, settings);
    if (settings.stereoMode != Right) parts.left = peak;
    if (settings.stereoMode == Right || settings.stereoMode == Same) parts.right = peak;
    if (settings.stereoMode == Opposite) parts.right = -peak;
    if (settings.stereoMode == Octave) parts.rightOctave = room * shareOf(parts.toneFrequency / 2, settings);
}

}  // namespace

MultiplexParts multiplexParts(const sim::InstrumentSettings& settings) {
    MultiplexParts parts;
    if (!settings.stereoOn) return parts;
    if (settings.pilotOn) parts.pilotDeviation = settings.pilotHertz;
    parts.pilotDegrees = settings.pilotDegrees;
    parts.rdsDeviation = settings.rdsHertz;
    parts.rdsDegrees = settings.rdsDegrees;
    addAri(settings, parts);
    addAudio(settings, parts);
    return parts;
}

}  // namespace kdx::air
