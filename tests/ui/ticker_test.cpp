#include "ui/ticker.h"

#include <gtest/gtest.h>

#include <QCoreApplication>
#include <QTimerEvent>

#include <limits>
#include <stdexcept>

namespace kdx {
namespace {

class TickerTest : public ::testing::Test {
protected:
    TickerGroup group;
};

TEST_F(TickerTest, RunsOnlyWhileEnabledWithAnInterval) {
    Ticker ticker(group, nullptr);
    ticker.setEnabled(true);
    EXPECT_FALSE(ticker.isActive());
    ticker.setPeriod(500);
    EXPECT_TRUE(ticker.isActive());
    EXPECT_EQ(ticker.interval(), 500);
    ticker.setPeriod(0);
    EXPECT_FALSE(ticker.isActive());
    ticker.setPeriod(10);
    ticker.setEnabled(false);
    EXPECT_FALSE(ticker.isActive());
}

TEST_F(TickerTest, IsPrecise) {
    const Ticker ticker(group, nullptr);
    EXPECT_EQ(ticker.timerType(), Qt::PreciseTimer);
}

TEST_F(TickerTest, RoundsToWholeMilliseconds) {
    Ticker ticker(group, nullptr);
    ticker.setPeriod(1.6);
    EXPECT_EQ(ticker.period(), 2);
}

TEST_F(TickerTest, ATickWhoseHandlerStillRunsLetsNoFurtherTickIn) {
    Ticker ticker(group, nullptr);
    ticker.setPeriod(10000);
    ticker.setEnabled(true);
    const auto tick = [&ticker] {
        QTimerEvent event(ticker.timerId());
        QCoreApplication::sendEvent(&ticker, &event);
    };
    int ticks = 0;
    QObject::connect(&ticker, &QTimer::timeout, [&] {
        if (++ticks < 5) tick();
    });
    tick();
    EXPECT_EQ(ticks, 1);
    tick();
    EXPECT_EQ(ticks, 2);
}

TEST_F(TickerTest, HoldsItsTicksBackAndGoesOn) {
    Ticker ticker(group, nullptr);
    ticker.setPeriod(500);
    ticker.setEnabled(true);
    group.setHeld(true);
    EXPECT_FALSE(ticker.isActive());
    ticker.setPeriod(600);
    EXPECT_FALSE(ticker.isActive());
    group.setHeld(false);
    EXPECT_TRUE(ticker.isActive());
    EXPECT_EQ(ticker.interval(), 600);
}

TEST_F(TickerTest, AGroupHoldsAllItsTimersAndThoseThatAreMadeMeanwhile) {
    Ticker first(group, nullptr);
    {
        const Ticker gone(group, nullptr);  // leaves the group with its end
    }
    group.setHeld(true);
    Ticker second(group, nullptr);
    for (Ticker* ticker : {&first, &second}) {
        ticker->setPeriod(500);
        ticker->setEnabled(true);
        EXPECT_FALSE(ticker->isActive());
    }
    group.setHeld(false);
    EXPECT_TRUE(first.isActive() && second.isActive());
}

TEST_F(TickerTest, RefusesIntervalsATimerDoesNotTake) {
    Ticker ticker(group, nullptr);
    ticker.setPeriod(65535);
    for (const double interval : {65536.0, -1.0, 1e300, std::numeric_limits<double>::quiet_NaN()}) {
        EXPECT_THROW(ticker.setPeriod(interval), std::out_of_range) << interval;
    }
    EXPECT_EQ(ticker.period(), 65535);
}

}  // namespace
}  // namespace kdx
