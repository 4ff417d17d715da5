#include "air/multiplextest.h"

namespace kdx::air {
namespace {

struct DataCase {
    const char* name;
    int rate;
    std::vector<const char*> commands;
};

std::string nameOfDataCase(const ::testing::TestParamInfo<DataCase>& info) {
    return info.param.name + std::to_string(info.param.rate);
}

constexpr const char* kFullAri = ":STEREO:ARI:STATE ON;:STEREO:ARI:TYPE:STATE ON;:STEREO:ARI:TYPE BKDK";

class MultiplexData : public MultiplexTest, public ::testing::WithParamInterface<DataCase> {
protected:
    MultiplexData() : MultiplexTest(GetParam().rate) {
        data();
        pilot();
        tone("1", "RNEL");
        coder("RT=10,0,HERE IS THE NEWS");
        for (const char* command : GetParam().commands) tell(command);
    }
};

TEST_P(MultiplexData, IsReceivedWithoutAnError) {
    send(10);
    EXPECT_EQ(bits.size(), 115U * 104U);
    EXPECT_EQ(bitErrors(), 0U);
}

INSTANTIATE_TEST_SUITE_P(Settings, MultiplexData,
                         ::testing::Values(DataCase{"Plain", 228000, {}}, DataCase{"Plain", 192000, {}},
                                           DataCase{"Ari", 228000, {kFullAri}}, DataCase{"Ari", 192000, {kFullAri}},
                                           DataCase{"PilotAhead", 228000, {":STEREO:PILOT:PHASE 4DEG"}},
                                           DataCase{"PilotAhead", 192000, {":STEREO:PILOT:PHASE 4DEG"}},
                                           DataCase{"PilotBehind", 228000, {":STEREO:PILOT:PHASE -4DEG"}},
                                           DataCase{"PilotBehind", 192000, {":STEREO:PILOT:PHASE -4DEG"}},
                                           DataCase{"Turned", 228000, {":STEREO:RDS:PHASE 123DEG"}},
                                           DataCase{"Loud", 192000, {":STEREO:DEVIATION 80000HZ"}}),
                         nameOfDataCase);

class MultiplexBits : public MultiplexTest {};

TEST_F(MultiplexBits, OfATestPatternAreThoseOfThePattern) {
    data();
    coder("BIN=4");
    send(2);
    const std::vector<bool> found = dataBits(samples, rate);
    ASSERT_GT(found.size(), 2000U);
    for (std::size_t at = 0; at < 2000; ++at) ASSERT_EQ(found[at], (at + 1) % 4 < 2) << at;
}

TEST_F(MultiplexBits, BeginWithTheFirstSampleAndTheCodeWith0) {
    // BIN=2 sends 1s, coded 1, 0, 1: the first bit begins with a positive half, the second with a negative one.
    data();
    coder("BIN=2");
    send(1);
    const auto halfBit = [this](std::size_t half) {
        double sum = 0;
        for (std::size_t at = half * 96; at < (half + 1) * 96; ++at)
            sum += static_cast<double>(samples[at]) * std::sin(std::acos(-1.0) / 2 * static_cast<double>(at));
        return sum;
    };
    EXPECT_GT(halfBit(0), 0.1);
    EXPECT_LT(halfBit(1), -0.1);
    EXPECT_LT(halfBit(2), -0.1);
    EXPECT_GT(halfBit(3), 0.1);
}

TEST_F(MultiplexBits, AreNotLostWhenSettingsChange) {
    data();
    pilot();
    tone("1", "LEFT");
    send(1);
    for (const char* command :
         {":STEREO:DEVIATION 40000HZ", ":STEREO:PILOT:STATE OFF", ":STEREO:AUDIO:MODE REML",
          ":STEREO:RDS:DEVIATION 4000HZ", ":STEREO:AUDIO:FREQUENCY 15KHZ", ":STEREO:RDS:DEVIATION 1000HZ",
          ":STEREO:AUDIO:PREEMPHASIS:STATE ON", ":STEREO:SOURCE LREXT", ":STEREO:RDS:PHASE 30DEG",
          ":STEREO:PILOT:STATE ON;:STEREO:PILOT:PHASE 5DEG", ":STEREO:DIRECT \"PS=ABC\""}) {
        tell(command);
        send(0.5);
    }
    EXPECT_EQ(bitErrors(), 0U);
}

TEST_F(MultiplexBits, AreNotLostWhenAriComesAndGoes) {
    // The data turn by 90 degrees: a receiver half-way between sees both.
    data();
    send(1);
    ari("BKDK", "C");
    send(2);
    tell(":STEREO:ARI:STATE OFF");
    send(1);
    EXPECT_EQ(bitErrors(45), 0U);
}

TEST_F(MultiplexBits, PauseWhileRdsIsOff) {
    data();
    send(2);
    tell(":STEREO:RDS:STATE OFF");
    send(2);
    // From 2.1 to 3.9 s: only what the first group's end still rings.
    EXPECT_EQ(peakOf(std::span<const float>(samples).subspan(478800, 410400)), 0);
    const std::size_t bitsBefore = bits.size();
    const std::size_t samplesBefore = samples.size();
    data();
    send(2);
    samples.erase(samples.begin(), samples.begin() + static_cast<std::ptrdiff_t>(samplesBefore));
    bits.erase(bits.begin(), bits.begin() + static_cast<std::ptrdiff_t>(bitsBefore));
    // What was kept still lacks the last 253 ticks before the data: 15 bits and 13 ticks.
    const std::vector<bool> found = dataBits(samples, rate);
    const auto first = std::search(found.begin(), found.end(), bits.begin() + 1, bits.begin() + 1001);
    EXPECT_LT(first - found.begin(), 20);
}

}  // namespace
}  // namespace kdx::air
