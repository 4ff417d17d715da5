#include "base/clock.h"

#include <gtest/gtest.h>

#include <stdexcept>

#include "support/fakeclock.h"

namespace kdx {
namespace {

using test::FakeClock;

TEST(WaitMsTest, ZeroReturnsAtOnceWithoutSleeping) {
    FakeClock clock(100);
    WaitMs(clock, 0);
    EXPECT_TRUE(clock.sleeps.empty());
}

TEST(WaitMsTest, WaitsUntilTheTargetIsReached) {
    FakeClock clock(100);
    WaitMs(clock, 50);
    EXPECT_NEAR(clock.secondsSinceMidnight(), 100.05, 1e-5);
}

TEST(WaitMsTest, ANegativeLengthReturnsAtOnce) {
    FakeClock clock(100);
    WaitMs(clock, -5);
    EXPECT_TRUE(clock.sleeps.empty());
}

TEST(WaitMsTest, TheTargetIsRoundedToSinglePrecision) {
    // At 23 hours a single-precision second count moves in steps of 1/128 s: 50 ms become 6 steps, 46.875 ms.
    FakeClock clock(82800);
    WaitMs(clock, 50);
    EXPECT_DOUBLE_EQ(clock.secondsSinceMidnight(), 82800.046875);
}

TEST(WaitMsTest, SleepsInsteadOfSpinning) {
    FakeClock clock(100);
    WaitMs(clock, 1000);
    EXPECT_LE(clock.sleeps.size(), 3U);
}

/// Gives up after a number of sleeps: the only way to look at a wait that never ends.
class ImpatientClock final : public Clock {
public:
    [[nodiscard]] double secondsSinceMidnight() const override { return m_clock.secondsSinceMidnight(); }
    [[nodiscard]] Date today() const override { return m_clock.today(); }
    [[nodiscard]] std::chrono::steady_clock::time_point steadyNow() const override { return m_clock.steadyNow(); }
    void sleep(std::chrono::nanoseconds duration) override {
        if (++m_sleeps > 1000) throw std::runtime_error("still waiting");
        m_clock.sleep(duration);
    }
    [[nodiscard]] int daysPassed() const { return m_clock.today().day - 5; }

private:
    FakeClock m_clock{86399.98};
    int m_sleeps = 0;
};

TEST(WaitMsTest, AWaitAcrossMidnightNeverEnds) {
    ImpatientClock clock;
    EXPECT_THROW(WaitMs(clock, 50), std::runtime_error);
    EXPECT_GT(clock.daysPassed(), 100);
}

TEST(WaitMsTest, AWaitAcrossMidnightEndsAfterItsLengthWhenMidnightIsCorrected) {
    FakeClock clock(86399.98);
    clock.correctMidnight(true);
    WaitMs(clock, 50);
    EXPECT_NEAR(clock.sleptMs(), 50, 0.01);
    EXPECT_LT(clock.secondsSinceMidnight(), 1);
}

/// Somebody sets the clock during the first sleep; how much later the wait still goes on is bounded here as well.
class ClockBeingSet final : public Clock {
public:
    explicit ClockBeingSet(double setTo) : m_setTo(setTo) {}
    [[nodiscard]] double secondsSinceMidnight() const override { return clock.secondsSinceMidnight(); }
    [[nodiscard]] Date today() const override { return clock.today(); }
    [[nodiscard]] std::chrono::steady_clock::time_point steadyNow() const override { return clock.steadyNow(); }
    void sleep(std::chrono::nanoseconds duration) override {
        if (clock.sleeps.size() > 1000) throw std::runtime_error("still waiting");
        clock.sleep(duration);
        if (clock.sleeps.size() == 1) clock.set(m_setTo);
    }

    FakeClock clock{40000};

private:
    double m_setTo;
};

TEST(WaitMsTest, AClockThatIsSetBackDelaysTheEndByATenthOfASecondAtMost) {
    for (const double setTo : {36400.0, 39999.0, 39999.99, 0.0}) {
        ClockBeingSet clock(setTo);
        WaitMs(clock, 50);
        EXPECT_GE(clock.clock.sleptMs(), 49) << setTo;
        EXPECT_LE(clock.clock.sleptMs(), 150.01) << setTo;
    }
}

TEST(WaitMsTest, AClockThatIsSetForwardEndsTheWait) {
    ClockBeingSet clock(50000);
    WaitMs(clock, 50);
    EXPECT_EQ(clock.clock.sleeps.size(), 1U);
}

TEST(SystemClockTest, TellsATimeOfDayAndADate) {
    const SystemClock clock;
    EXPECT_GE(clock.secondsSinceMidnight(), 0);
    EXPECT_LT(clock.secondsSinceMidnight(), 86400);
    EXPECT_GE(clock.today().year, 2024);
    EXPECT_GE(clock.today().month, 1);
    EXPECT_LE(clock.today().month, 12);
}

TEST(SystemClockTest, ItsSteadyTimeRunsWithASleep) {
    SystemClock clock;
    const auto before = clock.steadyNow();
    clock.sleep(std::chrono::milliseconds(2));
    EXPECT_GE(clock.steadyNow() - before, std::chrono::milliseconds(2));
}

}  // namespace
}  // namespace kdx
