#include "air/deviations.h"

#include <gtest/gtest.h>

#include "sim/setup.h"

namespace kdx::air {
namespace {

/// 40 kHz in all; pilot, RDS and ARI of 6750, 2000 and 3500 Hz, all of them off.
sim::Setup coder() {
    sim::Setup setup;
    setup.stereoOn = true;
    return setup;
}

TEST(Deviations, OfACoderThatIsOffAreNone) {
    sim::Setup setup;
    setup.pilotOn = setup.rdsOn = setup.ariOn = true;
    EXPECT_EQ(deviationsOf(setup).peak(), 0);
    EXPECT_EQ(deviationsOf(setup).total, 0);
}

TEST(Deviations, AudioGetsWhatTheOthersLeave) {
    sim::Setup setup = coder();
    EXPECT_EQ(deviationsOf(setup).audio, 40000);
    setup.pilotOn = true;
    EXPECT_EQ(deviationsOf(setup).audio, 40000 - 6750);
    setup.rdsOn = true;
    const Deviations of = deviationsOf(setup);
    EXPECT_EQ(of.audio, 40000 - 6750 - 2000);
    EXPECT_EQ(of.pilot, 6750);
    EXPECT_EQ(of.rds, 2000);
    EXPECT_EQ(of.peak(), of.total);
}

TEST(Deviations, AudioLeavesRoomForTheTonesOfAri) {
    sim::Setup setup = coder();
    setup.ariOn = true;
    EXPECT_EQ(deviationsOf(setup).ari, 3500);
    setup.ariTypeOn = true;
    setup.ariType = 1;  // announcement, 30 %
    EXPECT_DOUBLE_EQ(deviationsOf(setup).ari, 4550);
    setup.ariType = 2;  // area, 60 %
    EXPECT_DOUBLE_EQ(deviationsOf(setup).ari, 5600);
    setup.ariType = 3;  // both
    EXPECT_DOUBLE_EQ(deviationsOf(setup).ari, 6650);
    EXPECT_EQ(deviationsOf(setup).ariCarrier, 3500);
    EXPECT_DOUBLE_EQ(deviationsOf(setup).audio, 33350);
}

TEST(Deviations, SubcarriersBeyondTheTotalLeaveAudioNothing) {
    sim::Setup setup = coder();
    setup.pilotOn = setup.rdsOn = true;
    setup.mpxHertz = 8000;
    EXPECT_EQ(deviationsOf(setup).audio, 0);
    EXPECT_EQ(deviationsOf(setup).peak(), 8750);
}

}  // namespace
}  // namespace kdx::air
