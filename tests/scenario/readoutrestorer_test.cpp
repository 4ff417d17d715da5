#include "scenario/readoutrestorer.h"

#include "scenario/playtest.h"
#include "sim/simvisa.h"
#include "sim/virtualinstrument.h"

namespace kdx::test {
namespace {

class ReadoutRestorerTest : public PlayTest {
protected:
    ReadoutRestorerTest() { EXPECT_EQ(simulated.open("TCPIP", "10.0.0.1"), 0); }
    scenario::Outcome restored(const std::string& text) {
        return scenario::Runner({simulated, state, clock, *this, *this, &restorer}).run(read(text), {});
    }

    sim::VirtualInstrument device{clock};
    sim::SimVisa link{device};
    Session simulated{link, state, data, captions, clock, [] {}};
    scenario::ReadoutRestorer restorer{simulated.instrument};
};

TEST_F(ReadoutRestorerTest, WhateverWasSentStandsAsBeforeAfterwards) {
    device.execute(":STEREO:DIRECT \"EON-PI=D3C2\"");
    device.execute(":STEREO:DIRECT \"RT=10,0,as before\"");
    const Readout before = readOut(simulated.instrument);
    const auto outcome = restored(
        "restore: true\nsteps: [send: {PS: OTHER, PI: 1E10, RT: changed, PILOT: 1, EON_PI: ABCD, EON_TA: 1, "
        "\"HF:PEGEL:STATE\": ON}, {sweep: HF-Pegel, points: [10, 20], dwell: 1 s}]");
    EXPECT_TRUE(outcome.complete && outcome.restored);
    EXPECT_EQ(outcome.changed, Lines{});
    EXPECT_EQ(readOut(simulated.instrument), before);
    EXPECT_EQ(rows.back().step, "restore");
    for (const scenario::Row& row : rows) EXPECT_EQ(row.command.find('?'), std::string::npos) << row.command;
}

TEST_F(ReadoutRestorerTest, ItComesBackAfterAStopToo) {
    const Readout before = readOut(simulated.instrument);
    stopAt = std::chrono::seconds(10);
    begin = clock.steadyNow();
    EXPECT_FALSE(restored("restore: true\nsteps: [send: {PS: OTHER}, wait: 1 h]").complete);
    EXPECT_EQ(readOut(simulated.instrument), before);
}

TEST_F(ReadoutRestorerTest, WhatTheCoderCannotBeWithoutAgainIsNamedOnce) {
    const auto outcome = restored("restore: true\nsteps: [send: {AF1: \"N,98.5,87.6\"}]");
    EXPECT_TRUE(outcome.restored);
    EXPECT_EQ(outcome.changed, Lines{"AF1"});
}

TEST_F(ReadoutRestorerTest, AnInstrumentThatTellsNothingIsNotPlayedTo) {
    visa.readStatus = visa::kTimeout;
    scenario::ReadoutRestorer silent(session.instrument);
    EXPECT_FALSE(silent.remember());
}

TEST_F(ReadoutRestorerTest, OneThatTellsNoLongerIsNotRestored) {
    visa.answersTo = {{"*IDN?", "KDX\n"}, {coder("PS"), "\"RADIO   \"\n"}};
    scenario::ReadoutRestorer falling(session.instrument);
    EXPECT_TRUE(falling.remember());
    EXPECT_TRUE(falling.commands().has_value());
    visa.readStatus = visa::kConnectionLost;
    EXPECT_FALSE(falling.commands().has_value());
    EXPECT_FALSE(falling.changed().has_value());
}

}  // namespace
}  // namespace kdx::test
