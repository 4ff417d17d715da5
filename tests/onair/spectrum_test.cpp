#include "onair/spectrum.h"

#include <gtest/gtest.h>

#include <cmath>

#include "support/fakeclock.h"

namespace kdx {
namespace {

using namespace std::chrono_literals;

/// The spectrum of what goes out within a second after some commands.
class SpectrumTest : public ::testing::Test {
protected:
    void send(const std::vector<std::string>& commands) {
        for (const std::string& command : commands) shadow.take(command);
        shadow.setWatched(true);
        clock.advance(1s);
        shadow.catchUp();
        for (const air::Sent& sent : shadow.sent()) spectrum.take(sent);
    }
    /// The highest level near a frequency.
    double levelAt(double hertz) const {
        const std::vector<double> levels = spectrum.decibels();
        const auto step = static_cast<std::size_t>(std::lround(hertz / Spectrum::hertzOfStep()));
        return *std::max_element(&levels.at(step - 1), &levels.at(step + 1) + 1);
    }

    test::FakeClock clock;
    air::Shadow shadow{clock};
    Spectrum spectrum;
};

TEST_F(SpectrumTest, ThePilotStandsAtItsDeviation) {
    send({":STEREO:STATE ON", ":STEREO:PILOT:STATE ON", ":STEREO:PILOT:DEVIATION 7500HZ"});
    EXPECT_NEAR(levelAt(19000), -20, 1.5) << "a tenth of 75 kHz; a tone between two steps is up to 1.1 dB lower";
    EXPECT_LT(levelAt(25000), -80);
    EXPECT_NEAR(spectrum.peakHertz(), 7500, 75);
}

TEST_F(SpectrumTest, TheDataStandOnBothSidesOf57Kilohertz) {
    send({":STEREO:STATE ON", ":STEREO:RDS:STATE ON", ":STEREO:RDS:DEVIATION 2000HZ"});
    EXPECT_GT(levelAt(57000 + 1000), -70);
    EXPECT_GT(levelAt(57000 - 1000), -70);
    EXPECT_LT(levelAt(53000), -80);
}

TEST_F(SpectrumTest, NothingGoesOutWhileTheStereoCoderIsOff) {
    send({":STEREO:STATE OFF", ":STEREO:PILOT:STATE ON"});
    EXPECT_EQ(spectrum.peakHertz(), 0);
    EXPECT_EQ(levelAt(19000), Spectrum::kLowestDecibel);
}

}  // namespace
}  // namespace kdx
