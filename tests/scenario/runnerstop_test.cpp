#include <algorithm>

#include "scenario/playtest.h"

namespace kdx::test {
namespace {

using RunnerStopTest = PlayTest;
using namespace std::chrono_literals;

TEST_F(RunnerStopTest, WhatStoodBeforeComesBackAtTheEnd) {
    const auto outcome = play("restore: true\nsteps: [send: {TA: 1}]");
    EXPECT_TRUE(outcome.complete && outcome.restored);
    EXPECT_EQ(heard, (Lines{"remember", "1 TA=1 0", "finishes", "bring back", "restore TA= 0", "ended"}));
}

TEST_F(RunnerStopTest, AnInstrumentThatIsSilentForSomeSecondsIsRestoredAllTheSame) {
    silentRestores = 4;
    const auto outcome = play("restore: true\nsteps: [send: {TA: 1}]");
    EXPECT_TRUE(outcome.restored);
    EXPECT_EQ(std::count(heard.begin(), heard.end(), "bring back"), 5);
    EXPECT_EQ(sent().back(), direct("TA=0"));
    EXPECT_GE(clock.steadyNow() - begin, 4s);
}

TEST_F(RunnerStopTest, WhereNothingCanBeBroughtBackWhatWasSentIsNamed) {
    silentRestores = 1000;
    const auto outcome = play("restore: true\nsteps: [send: {TA: 1, PS: OTHER}, send: {TA: 0}]");
    EXPECT_FALSE(outcome.restored);
    EXPECT_EQ(outcome.changed, (Lines{"PS", "TA"}));
    EXPECT_LT(clock.steadyNow() - begin, 10s);
}

TEST_F(RunnerStopTest, WhatWasNotKnownBeforeIsNamedWhereItWasSent) {
    silentBefore = {"PI", "RT", "RT_N", "FM", "AF2", "EON_PS", "GROUPSEQ"};
    EXPECT_EQ(play("restore: true\nsteps: [send: {TA: 1}]").untold, Lines{});
    EXPECT_EQ(play("restore: true\nsteps: [send: {FM_AUS: 1, AF1: \"N,98.5\"}]").untold, (Lines{"FM", "AF2"}));
    EXPECT_EQ(play("restore: true\nsteps: [send: {DEL_RT: 1, EON_PI: ABCD}]").untold, (Lines{"RT", "RT_N", "EON_PS"}));
    folder.copyShipped();
    session.load(Profile::ofFile(data, dataSetFile("2")));
    EXPECT_EQ(play("restore: true\ndata_set: 2\nsteps: [note: a]").untold, silentBefore);
}

TEST_F(RunnerStopTest, WithoutRestoreNothingIsAskedAndNothingComesBack) {
    play("steps: [send: {TA: 1}]");
    EXPECT_EQ(heard, (Lines{"1 TA=1 0", "ended"}));
}

TEST_F(RunnerStopTest, WhereNothingCanBeRememberedNothingIsSent) {
    remembers = false;
    EXPECT_FALSE(play("restore: true\nsteps: [send: {TA: 1}]").complete);
    EXPECT_EQ(heard, (Lines{"remember", "ended"}));
    EXPECT_EQ(sent(), Lines{});
}

TEST_F(RunnerStopTest, AStopEndsALongWaitAtOnceAndRestores) {
    stopAt = 3s;
    EXPECT_FALSE(play("restore: true\nsteps: [send: {TA: 1}, wait: 100 h, note: never]").complete);
    EXPECT_EQ(heard, (Lines{"remember", "1 TA=1 0", "finishes", "bring back", "restore TA= 0", "ended"}));
    EXPECT_LT(clock.steadyNow() - begin, 3200ms);
}

TEST_F(RunnerStopTest, AStopInASweepEndsAfterTheRunningCommand) {
    stopAt = 4500ms;
    EXPECT_FALSE(
        play("steps: [{sweep: HF-Pegel, from: 60, to: 0, step: -1, dwell: 1 s, until: Return}, note: never]").complete);
    EXPECT_EQ(sent().size(), 5U);
    EXPECT_EQ(heard.back(), "ended");
}

TEST_F(RunnerStopTest, AStopEndsAPauseAndAnExpectation) {
    stopAt = 2s;
    EXPECT_FALSE(play("steps: [pause: ready, note: never]").complete);
    EXPECT_EQ(heard, (Lines{"1 pause=ready no Return", "ended"}));
    stopped = false;
    visa.answersTo = {{coder("TA"), "\"1\"\n"}};
    const auto outcome = play("steps: [expect: {TA: 0, within: 1 h}, note: never]");
    EXPECT_FALSE(outcome.complete);
    EXPECT_EQ(outcome.unmet, 0U);
    EXPECT_EQ(rows.back().status, "stopped");
    EXPECT_LT(clock.steadyNow() - begin, 2200ms);
}

TEST_F(RunnerStopTest, APauseWithoutFurtherInputIsAStop) {
    inputEnds = true;
    EXPECT_FALSE(play("restore: true\nsteps: [pause: ready, note: never]").complete);
    EXPECT_EQ(heard[1], "1 pause=ready no Return");
    EXPECT_EQ(heard[3], "bring back");
}

TEST_F(RunnerStopTest, AFailedCommandEndsTheRunAndRestores) {
    visa.writeStatuses = {0, visa::kTimeout, 0};
    const auto outcome = play("restore: true\nsteps: [send: {TA: 1, TP: 1, PTY: 5}]");
    EXPECT_FALSE(outcome.complete);
    EXPECT_EQ(heard, (Lines{"remember", "1 TA=1 0", "1 TP=1 -1073807339", "finishes", "bring back", "restore TA= 0",
                            "ended"}));
}

TEST_F(RunnerStopTest, AFailureOfTheLastCommandCounts) {
    visa.writeStatus = visa::kConnectionLost;
    EXPECT_FALSE(play("steps: [send: {TA: 1}]").complete);
}

TEST_F(RunnerStopTest, AnExceptionRestoresToo) {
    scenario::Scenario forced = scenario::readScenario("restore: true\nsteps: [send: {MPX_HUB: 1}]").scenario;
    forced.actions[0].settings[0].second = std::string(400, '9');
    scenario::Runner runner({session, state, clock, *this, *this, this, nullptr});
    EXPECT_THROW(runner.run(forced, {}), std::overflow_error);
    EXPECT_EQ(heard, (Lines{"remember", "finishes", "bring back", "restore TA= 0"}));
}

}  // namespace
}  // namespace kdx::test
