#include "scenario/playtest.h"

namespace kdx::test {
namespace {

using namespace std::chrono_literals;

/// Who has other things to do takes a run from one pause to the next.
class RunnerPiecesTest : public PlayTest {
protected:
    void start(const std::string& text) {
        scenario = read(text);
        runner.emplace(scenario::Surroundings{session, state, clock, *this, *this, this, report});
        runner->start(scenario, {});
    }
    /// Takes it on until it wants to wait; the time that it wants to.
    std::chrono::nanoseconds toNextWait() {
        for (;;) {
            const auto pause = runner->goOn();
            if (!pause) return -1ns;
            if (pause->count() > 0) return *pause;
        }
    }

    scenario::Scenario scenario;
    std::optional<scenario::Runner> runner;
};

TEST_F(RunnerPiecesTest, NothingSleepsAndNothingGoesOnBeforeItsTime) {
    start("steps: [wait: 10 s, send: {TA: 1}]");
    clock.sleeps.clear();
    for (int asked = 3; asked > 0; --asked) EXPECT_EQ(toNextWait(), 50ms);  // no time has passed
    EXPECT_TRUE(clock.sleeps.empty());
    clock.advance(10s);
    EXPECT_EQ(toNextWait(), -1ns);
    EXPECT_EQ(sent(), Lines{direct("TA=1")});
    EXPECT_TRUE(runner->outcome().complete);
}

TEST_F(RunnerPiecesTest, OthersHaveTheirTurnBetweenTwoCommands) {
    start("steps: [send: {TA: 1, TP: 1, PTY: 2}]");
    std::size_t pieces = 0;
    while (runner->goOn()) {
        ++pieces;
        EXPECT_LE(sent().size(), 1U);
    }
    EXPECT_GE(pieces, 3U);
}

TEST_F(RunnerPiecesTest, ARunThatIsLeftInTheMiddleLeavesNothingBehind) {
    start("steps: [{repeat: 3, steps: [{sweep: HF-Pegel, points: [60, 50], dwell: 1 s}]}]");
    toNextWait();
    runner.reset();
    EXPECT_EQ(sent(), Lines{":POW 60DBUV"});
}

TEST_F(RunnerPiecesTest, AMillionPassesTakeNoStack) {
    start("steps: [{repeat: 1000000, steps: [{repeat: 1, steps: [note: a]}]}]");
    for (int pieces = 200'000; pieces > 0; --pieces) ASSERT_TRUE(runner->goOn());
    EXPECT_GT(rows.size(), 60'000U);
}

}  // namespace
}  // namespace kdx::test
