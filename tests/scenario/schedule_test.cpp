#include "scenario/schedule.h"

#include "scenario/playtest.h"

namespace kdx::test {
namespace {

using ScheduleTest = PlayTest;
using namespace std::chrono_literals;

TEST_F(ScheduleTest, TenThousandStepsDoNotDrift) {
    play("steps: [{repeat: 10000, steps: [send: {TA: 1}, wait: 130 ms]}]");
    ASSERT_EQ(writtenAt.size(), 10'000U);
    for (std::size_t i = 0; i < writtenAt.size(); ++i) {
        const long due = static_cast<long>(i) * 130;
        ASSERT_GE(writtenAt[i], due);
        ASSERT_LE(writtenAt[i], due + 60) << i;  // at most the pause before one command
    }
    EXPECT_EQ(clock.steadyNow() - begin, 10'000 * 130ms);
}

TEST_F(ScheduleTest, ASweepOfTenThousandPointsDoesNotDriftEither) {
    play(
        "steps: [{sweep: HF-Pegel, from: 0, to: 99.99, step: 0.01, dwell: 200 ms, steps: [send: {TA: 1}, wait: 70 ms, "
        "send: {TA: 0}]}]");
    ASSERT_EQ(writtenAt.size(), 30'000U);
    for (std::size_t i = 0; i < writtenAt.size(); i += 3)
        ASSERT_NEAR(writtenAt[i], static_cast<double>(i) / 3 * 200 + 50, 5);
    EXPECT_EQ(clock.steadyNow() - begin, 10'000 * 200ms);
}

TEST_F(ScheduleTest, WhatCommandsTakeIsPartOfTheWaitAfterThem) {
    play("steps: [send: {TA: 1, TP: 1, PTY: 1}, wait: 1 s, send: {TA: 0}]");
    EXPECT_NEAR(static_cast<double>(writtenAt[3]), 1050, 2);
}

TEST_F(ScheduleTest, WhatWasMissedIsNotMadeUpForInHaste) {
    // Four commands take 200 ms: the first wait is over by then, the second one is a whole one.
    play("steps: [send: {TA: 1, TP: 1, PTY: 1, MS: M}, wait: 100 ms, wait: 100 ms, send: {TA: 0}]");
    EXPECT_NEAR(static_cast<double>(writtenAt[4]), 350, 5);
}

TEST_F(ScheduleTest, APersonsPauseMovesWhatFollows) {
    returns = {10s};
    play("steps: [wait: 1 s, pause: ready, wait: 1 s, send: {TA: 1}]");
    EXPECT_NEAR(static_cast<double>(writtenAt[0]), 11'050, 60);
}

TEST_F(ScheduleTest, ARunOverMidnightGoesOn) {
    clock.set(86'399.5);
    play("steps: [{repeat: 20, steps: [send: {TA: 1}, wait: 100 ms]}]");
    ASSERT_EQ(writtenAt.size(), 20U);
    for (std::size_t i = 0; i < writtenAt.size(); ++i)
        EXPECT_NEAR(static_cast<double>(writtenAt[i]), i * 100.0 + 50, 10);
    EXPECT_EQ(rows.front().time.substr(0, 19), "2009-03-05 23:59:59");
    EXPECT_EQ(rows.back().time.substr(0, 19), "2009-03-06 00:00:01");
}

TEST_F(ScheduleTest, ARunOverAChangeOfTheClockGoesOn) {
    returns = {0s};
    play("steps: [wait: 1 s, send: {TA: 1}]");
    clock.set(3600);
    play("steps: [wait: 1 s, send: {TA: 1}]");
    EXPECT_NEAR(static_cast<double>(writtenAt[1]), 1050, 2);
}

TEST_F(ScheduleTest, AWaitIsToldWithItsLength) {
    play("steps: [wait: 2 s, send: {TA: 1}, wait: 1 s]");
    ASSERT_EQ(waited.size(), 2U);
    EXPECT_EQ(waited[0], 2000);
    EXPECT_NEAR(static_cast<double>(waited[1]), 950, 2);
}

}  // namespace
}  // namespace kdx::test
