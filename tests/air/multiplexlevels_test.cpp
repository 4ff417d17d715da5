#include <numbers>

#include "air/multiplextest.h"

namespace kdx::air {
namespace {

constexpr double kDegree = std::numbers::pi / 180;

class MultiplexLevels : public MultiplexTest {
protected:
    /// Phase of a frequency at the first sample, in degrees; a sine that begins there has 0.
    [[nodiscard]] double phaseOf(std::span<const float> part, double frequency) const {
        return std::arg(amplitudeOf(part, frequency, rate) * std::complex<double>(0, 1)) / kDegree;
    }
    static void expectWithin(double part, double measured, double expected) {
        EXPECT_NEAR(measured, expected, part * expected);
    }
    /// The amplitudes of a frequency in the channels that a receiver finds: left, right.
    [[nodiscard]] std::pair<double, double> channels(std::span<const float> part, double frequency) const {
        std::vector<float> difference(part.size());
        for (std::size_t at = 0; at < part.size(); ++at) {
            const double turns = 38000.0 / rate * static_cast<double>(at);
            difference[at] = static_cast<float>(2 * part[at] * std::sin(360 * kDegree * (turns - std::floor(turns))));
        }
        const auto sum = amplitudeOf(part, frequency, rate);
        const auto side = amplitudeOf(difference, frequency, rate);
        return {std::abs(sum + side) * 100000, std::abs(sum - side) * 100000};
    }
};

constexpr double kHalfPercent = 0.005;

TEST_F(MultiplexLevels, WithTheCoderOffThereIsNoMultiplex) {
    pilot();
    data();
    tone("1", "LEFT");
    tell(":STEREO:STATE OFF");
    EXPECT_EQ(peakOf(sent(1)), 0);
    tell(":STEREO:STATE ON");
    EXPECT_GT(peakOf(sent(1)), 60000);
}

TEST_F(MultiplexLevels, ThePilotHasItsDeviationAndItsPhase) {
    pilot();
    for (const auto& [deviation, degrees] : {std::pair(6750, 0), std::pair(8000, 5), std::pair(100, -4)}) {
        tell(":STEREO:PILOT:DEVIATION " + std::to_string(deviation) + "HZ;:STEREO:PILOT:PHASE " +
             std::to_string(degrees) + "DEG");
        (void)sent(0.1);
        samples.erase(samples.begin(), samples.end() - static_cast<std::ptrdiff_t>(samples.size() % 12));
        const auto part = sent(0.5);
        expectWithin(kHalfPercent, deviationOf(part, 19000), deviation);
        expectWithin(kHalfPercent, peakOf(part), deviation);
    }
}

TEST_F(MultiplexLevels, ThePilotIsAheadOfTheSubcarrierByItsPhase) {
    pilot();
    tone("1", "REML");
    tell(":STEREO:PILOT:PHASE 5DEG");
    const auto part = sent(1);
    EXPECT_NEAR(phaseOf(part, 19000), 5, 0.01);
    // The side frequencies of a sine on a sine: the phases of cosines with opposite signs add up to twice the
    // carrier's.
    EXPECT_NEAR(std::remainder(phaseOf(part, 37000) + phaseOf(part, 39000), 360), 0, 0.01);
}

TEST_F(MultiplexLevels, TheCarrierOf57KilohertzIsThreeTimesThePilot) {
    pilot();
    ari("DK", "A");
    tell(":STEREO:ARI:TYPE:STATE OFF");
    const auto all = sent(20);
    for (const std::size_t second : {0U, 9U, 19U}) {
        const auto part = all.subspan(second * static_cast<std::size_t>(rate), static_cast<std::size_t>(rate));
        EXPECT_NEAR(phaseOf(part, 19000), 0, 0.001);
        EXPECT_NEAR(phaseOf(part, 57000), 0, 0.001);
    }
}

TEST_F(MultiplexLevels, DataHaveTheirPhaseWhateverThePilotsAndAQuarterTurnMoreBesideAri) {
    // The pattern of zeros is two lines; what their phases add up to is twice the carrier's.
    data();
    pilot();
    coder("BIN=1");
    tell(":STEREO:PILOT:PHASE 5DEG");
    for (const auto& [state, turn] : {std::pair("OFF", 0), std::pair("ON", 90)}) {
        for (const int degrees : {0, 30, 120}) {
            tell(":STEREO:RDS:PHASE " + std::to_string(degrees) + "DEG;:STEREO:ARI:STATE " + state);
            (void)sent(0.1);
            const auto part = sent(1);
            const double phases = phaseOf(part, 58187.5) + phaseOf(part, 55812.5);
            EXPECT_NEAR(std::remainder(phases - 2 * (degrees + turn), 360), 0, 0.01);
        }
    }
}

TEST_F(MultiplexLevels, ChannelsAreThoseOfTheStereoMode) {
    // Without pilot, RDS and ARI the tone has all of the 75 kHz.
    struct Mode {
        const char* name;
        double left;
        double right;
        double rightOctave;
    };
    for (const Mode& mode : {Mode{"LEFT", 75000, 0, 0}, Mode{"RIGHT", 0, 75000, 0}, Mode{"REL", 75000, 75000, 0},
                             Mode{"REML", 75000, 75000, 0}, Mode{"RNEL", 75000, 0, 75000}}) {
        SCOPED_TRACE(mode.name);
        tone("2", mode.name);
        (void)sent(0.1);
        const auto part = sent(1);
        const auto [left, right] = channels(part, 2000);
        const auto [leftOctave, rightOctave] = channels(part, 1000);
        // What is not there is at least 100 dB down.
        EXPECT_NEAR(left, mode.left, std::max(mode.left * kHalfPercent, 0.75));
        EXPECT_NEAR(right, mode.right, std::max(mode.right * kHalfPercent, 0.75));
        EXPECT_NEAR(rightOctave, mode.rightOctave, std::max(mode.rightOctave * kHalfPercent, 0.75));
        EXPECT_LT(leftOctave, 0.75);
    }
}

TEST_F(MultiplexLevels, OppositeChannelsHaveNoSum) {
    tone("1", "REML");
    EXPECT_LT(deviationOf(sent(1), 1000), 0.75);
    tone("1", "REL");
    (void)sent(0.1);
    EXPECT_LT(deviationOf(sent(1), 37000), 0.75);
}

TEST_F(MultiplexLevels, ExternalSourcesAndTonesBeyondTheSoundChannelAreSilence) {
    tone("15.001", "REL");
    EXPECT_EQ(peakOf(sent(0.5)), 0);
    tell(":STEREO:SOURCE LREXT;:STEREO:AUDIO:FREQUENCY 1KHZ");
    EXPECT_EQ(peakOf(sent(0.5)), 0);
}

TEST_F(MultiplexLevels, PreemphasisLiftsATone) {
    // 15 kHz fill the share, lower ones have what a resistor and a capacitor make of it.
    for (const auto& [word, microseconds] : {std::pair("50US", 50.0), std::pair("75US", 75.0)}) {
        tell(std::string(":STEREO:AUDIO:PREEMPHASIS:STATE ON;:STEREO:AUDIO:PREEMPHASIS ") + word);
        const auto lift = [time = microseconds](double kilohertz) {
            const double turns = 2 * std::numbers::pi * kilohertz * time / 1000;
            return std::sqrt(1 + turns * turns);
        };
        for (const char* kilohertz : {"0.1", "1", "5", "10", "15"}) {
            tone(kilohertz, "REL");
            (void)sent(0.1);
            const double frequency = std::stod(kilohertz);
            expectWithin(0.01, deviationOf(sent(0.5), frequency * 1000), 75000 * lift(frequency) / lift(15));
        }
    }
}

TEST_F(MultiplexLevels, AriHasItsCarrierAndTonesOfTheirDepth) {
    tell(":STEREO:ARI:DEVIATION 3500HZ");
    const std::array frequencies = {23.75, 28.2738, 34.9265, 39.5833, 45.6731, 53.9773};
    for (std::size_t area = 0; area < frequencies.size(); ++area) {
        SCOPED_TRACE(area);
        ari("BKDK", std::string(1, static_cast<char>('A' + area)));
        (void)sent(0.1);
        const auto part = sent(2);
        expectWithin(kHalfPercent, deviationOf(part, 57000), 3500);
        expectWithin(kHalfPercent, deviationOf(part, 57000 + frequencies.at(area)), 3500 * 0.6 / 2);
        expectWithin(kHalfPercent, deviationOf(part, 57000 - frequencies.at(area)), 3500 * 0.6 / 2);
        expectWithin(kHalfPercent, deviationOf(part, 57125), 3500 * 0.3 / 2);
    }
    ari("BK", "A");
    (void)sent(0.1);
    EXPECT_LT(deviationOf(sent(2), 57125), 0.1);
    ari("DK", "A");
    (void)sent(0.1);
    EXPECT_LT(deviationOf(sent(2), 57023.75), 0.1);
    tell(":STEREO:ARI:TYPE:STATE OFF");
    (void)sent(0.1);
    expectWithin(1e-4, peakOf(sent(2)), 3500);
}

TEST_F(MultiplexLevels, DataHaveTheirDeviationAsGreatestPeak) {
    data();
    coder("RT=10,0,HERE IS THE NEWS");
    for (const double deviation : {2000.0, 4000.0}) {
        tell(":STEREO:RDS:DEVIATION " + std::to_string(static_cast<int>(deviation)) + "HZ");
        (void)sent(0.1);
        const auto part = sent(5);
        double power = 0;
        for (const float sample : part) power += static_cast<double>(sample) * static_cast<double>(sample);
        // Upon a carrier half of the signal's power is left.
        const double ofSignal = std::sqrt(2 * power / static_cast<double>(part.size())) * 100000;
        expectWithin(kHalfPercent, ofSignal, 0.693 * deviation);
        EXPECT_LE(peakOf(part), deviation);
        EXPECT_GE(peakOf(part), 0.95 * deviation);
    }
}

TEST_F(MultiplexLevels, DataKeepTheirBand) {
    data();
    coder("RT=10,0,HERE IS THE NEWS");
    for (const int sampleRate : {kMultiplexRate, kLowMultiplexRate}) {
        rate = sampleRate;
        multiplex = Multiplex(sampleRate);
        EXPECT_LE(decibelsBeside(sent(2), 54600, 59400, rate), -90) << rate;
    }
}

TEST_F(MultiplexLevels, AllPartsTogetherPeakAtTheTotalDeviation) {
    data();
    pilot();
    tone("1", "REL");
    for (const bool hasAri : {false, true}) {
        if (hasAri) ari("BKDK", "B");
        (void)sent(0.1);
        const double peak = peakOf(sent(5));
        EXPECT_LE(peak, 75000);
        EXPECT_GE(peak, 66000);
    }
}

TEST_F(MultiplexLevels, DataThatBeginAndEndKeepWithinTheTotalDeviation) {
    tone("1", "REL");
    tell(":STEREO:RDS:DEVIATION 4000HZ");
    for (int times = 0; times < 10; ++times) {
        send(0.1);
        data();
        send(0.1);
        tell(":STEREO:RDS:STATE OFF");
    }
    const double peak = peakOf(samples);
    EXPECT_LE(peak, 75001);
    EXPECT_GE(peak, 74900);
}

TEST_F(MultiplexLevels, TheAudioGetsWhatTheOthersLeave) {
    data();
    pilot();
    tone("1", "REL");
    expectWithin(kHalfPercent, deviationOf(sent(1), 1000), 75000 - 2000 - 6750);
    ari("BKDK", "B");
    (void)sent(0.1);
    expectWithin(kHalfPercent, deviationOf(sent(1), 1000), 75000 - 2000 - 6750 - 3500 * 1.9);
    tell(":STEREO:DEVIATION 10000HZ");
    (void)sent(0.1);
    EXPECT_LT(deviationOf(sent(1), 1000), 0.5);
    expectWithin(kHalfPercent, deviationOf(sent(1), 19000), 6750);
}

TEST_F(MultiplexLevels, ChangesMakeNoClick) {
    data();
    pilot();
    tone("1", "LEFT");
    double steady = greatestStepOf(sent(0.5));
    double changing = 0;
    for (const char* command :
         {":STEREO:DEVIATION 40000HZ", ":STEREO:PILOT:STATE OFF", ":STEREO:AUDIO:MODE REML",
          ":STEREO:RDS:DEVIATION 4000HZ", ":STEREO:AUDIO:FREQUENCY 14KHZ", ":STEREO:AUDIO:PREEMPHASIS:STATE ON",
          ":STEREO:PILOT:STATE ON;:STEREO:PILOT:PHASE 180DEG", ":STEREO:RDS:PHASE 200DEG", ":STEREO:ARI:STATE ON",
          ":STEREO:STATE OFF", ":STEREO:STATE ON", ":STEREO:RDS:STATE OFF", ":STEREO:RDS:STATE ON",
          ":STEREO:DEVIATION 75000HZ;:STEREO:AUDIO:FREQUENCY 0.3KHZ"}) {
        SCOPED_TRACE(command);
        const float last = samples.back();
        tell(command);
        const auto fading = sent(0.2);
        const double first = std::abs(static_cast<double>(fading.front()) - static_cast<double>(last));
        changing = std::max(greatestStepOf(fading), first);
        const double after = greatestStepOf(sent(0.5));
        // What fades over 5 ms adds at most both signals' peaks divided by the samples of that time.
        EXPECT_LE(changing, std::max(steady, after) + 2 * 0.75 / 1140);
        steady = after;
    }
}

}  // namespace
}  // namespace kdx::air
