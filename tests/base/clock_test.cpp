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

TEST(SystemClockTest, TellsATimeOfDayAndADate) {
    const SystemClock clock;
    EXPECT_GE(clock.secondsSinceMidnight(), 0);
    EXPECT_LT(clock.secondsSinceMidnight(), 86400);
    EXPECT_GE(clock.today().year, 2024);
    EXPECT_GE(clock.today().month, 1);
    EXPECT_LE(clock.today().month, 12);
}

}  // namespace
}  // namespace kdx
