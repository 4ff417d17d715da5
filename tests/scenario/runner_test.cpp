#include "scenario/runner.h"

#include "scenario/playtest.h"

namespace kdx::test {
namespace {

using RunnerTest = PlayTest;
using namespace std::chrono_literals;

TEST_F(RunnerTest, SendsSettingsInTheOrderOfTheFile) {
    const auto outcome = play("steps: [send: {TP: 1, PS: RADIO, PI: 1E10}, note: half]");
    EXPECT_TRUE(outcome.complete);
    EXPECT_EQ(sent(), (Lines{":stereo:rds:traffic:program ON", direct("PS=RADIO   "), direct("PI=1E10")}));
    EXPECT_EQ(heard, (Lines{"1 TP=1 0", "1 PS=RADIO 0", "1 PI=1E10 0", "2 note=half ", "ended"}));
    EXPECT_EQ(begun, (Lines{"1 send TP=1 PS=RADIO PI=1E10", "2 note: half"}));
}

TEST_F(RunnerTest, CommandsAboutTheOtherNetworkFollowItsPi) {
    state.eonIdentifier = "D3C0";
    play("steps: [send: {EON_TA: 1}, send: {EON_PI: ABCD, EON_TA: 0}]");
    EXPECT_EQ(sent(), (Lines{direct("EON-TA=D3C0,1"), direct("EON-PI=ABCD"), direct("EON-TA=ABCD,0")}));
}

TEST_F(RunnerTest, NestedSweepsGoThroughAllPoints) {
    play(
        "steps: [{sweep: HF-Frequenz, points: [98.5, 101], steps: [{sweep: HF-Pegel, from: 60, to: 59.8, step: -0.1, "
        "steps: [send: {TA: 1}]}]}]");
    EXPECT_EQ(sent(), (Lines{"FREQ 98.5MHZ", ":POW 60DBUV", direct("TA=1"), ":POW 59.9DBUV", direct("TA=1"),
                             ":POW 59.8DBUV", direct("TA=1"), "FREQ 101MHZ", ":POW 60DBUV", direct("TA=1"),
                             ":POW 59.9DBUV", direct("TA=1"), ":POW 59.8DBUV", direct("TA=1")}));
    EXPECT_EQ(heard[3], "1#1.1#2 HF-Pegel=59.9 0");
    EXPECT_EQ(heard[13], "1#2.1#3.1 TA=1 0");
}

TEST_F(RunnerTest, TheFirstPointOfASweepLastsAsLongAsTheOthersWhateverWasSentBefore) {
    play(
        "steps: [send: {TA: 1, TP: 1, PS: A, PTY: 1, MS: M, PI: ABCD}, {sweep: HF-Pegel, points: [60, 50, 40], "
        "dwell: 500 ms}]");
    const std::size_t first = writtenAt.size() - 3;
    EXPECT_EQ(writtenAt[first + 1] - writtenAt[first], 500);
    EXPECT_EQ(writtenAt[first + 2] - writtenAt[first + 1], 500);
}

TEST_F(RunnerTest, WhatWasTypedBeforeIsNoAnswerToAPauseOrALoop) {
    returns = {1s, 2s};
    play("steps: [note: a, pause: ready, {repeat: 2, until: Return, steps: [wait: 1 s]}]");
    EXPECT_EQ(forgotten, 2);
    forgotten = 0;
    scenario::RunOptions nobody;
    nobody.nobodyThere = true;
    play("steps: [pause: ready]", nobody);
    EXPECT_EQ(forgotten, 0);
}

TEST_F(RunnerTest, ATrafficMessageGoesOutWithItsAnnouncementInTurn) {
    play("steps: [{repeat: 2, steps: [tmc: 0B90E400CC]}]");
    EXPECT_EQ(sent(), (Lines{direct("3A=01,106100CD46"), direct("8A=02,0B90E400CC"), direct("3A=01,100066CD46"),
                             direct("8A=02,0B90E400CC")}));
}

TEST_F(RunnerTest, ADataSetIsSentAsAtTheOpening) {
    folder.copyShipped();
    visa.answersTo = {{"*IDN?", "KDX\n"}, {coder("EON PI?"), "\"D3C2\"\n"}};
    session.load(Profile::ofFile(data, dataSetFile("2")));
    play("data_set: 2\nsteps: [send: {TA: 1}]");
    const Lines commands = sent();
    EXPECT_EQ(commands.front(), "*IDN?");
    EXPECT_GT(commands.size(), 40U);
    EXPECT_EQ(commands.back(), direct("TA=1"));
    EXPECT_EQ(rows.front().step, "data_set");
    EXPECT_EQ(rows.size(), commands.size());
}

TEST_F(RunnerTest, AnEmptyAnswerThatIsExpectedIsTold) {
    play("steps: [expect: {pilot: [\"\", 675, 0]}]");
    EXPECT_EQ(begun, Lines{"1 expect pilot=,675,0"});
}

TEST_F(RunnerTest, AnExpectationIsMetByTheAnswerWithoutItsBlanks) {
    visa.answersTo = {{coder("PS"), "\"RADIO   \"\n"}, {coder("TA"), "\"0\"\n"}, {"FREQ?", "98.5\n"}};
    const auto outcome = play("steps: [expect: {PS: RADIO, TA: 0, frequency: 98.50}]");
    EXPECT_EQ(outcome.unmet, 0U);
    EXPECT_EQ(heard, (Lines{"1 PS=RADIO met RADIO", "1 TA=0 met 0", "1 frequency=98.50 met 98.5", "ended"}));
    EXPECT_EQ(rows[0].command, coder("PS"));
}

TEST_F(RunnerTest, AnEmptyAnswerAndOneOfSeveralPartsCanBeExpected) {
    visa.answersTo = {{coder("RT"), "\"\"\n"},
                      {coder("PIL"), "\"1\"\n"},
                      {coder("PIL-DEV"), "\"675\"\n"},
                      {coder("PIL-PH"), "\"0\"\n"}};
    EXPECT_EQ(play("steps: [expect: {rt: \"\", pilot: [1, 675, 0]}]").unmet, 0U);
    EXPECT_EQ(play("steps: [expect: {pilot: [1, 676, 0]}]").unmet, 1U);
}

TEST_F(RunnerTest, AnAnswerThatIsLongerThanOneReadIsReadToItsEnd) {
    const std::string text(64, 'x');
    visa.answersTo = {{coder("RT"), "\"" + text + "\"\n"}, {coder("TA"), "\"1\"\n"}};
    EXPECT_EQ(play("steps: [expect: {RT: " + text + ", TA: 1}]").unmet, 0U);
}

TEST_F(RunnerTest, AnUnmetExpectationIsCountedAndTheRunGoesOn) {
    visa.answersTo = {{coder("TA"), "\"1\"\n"}};
    const auto outcome = play("steps: [expect: {TA: 0}, send: {TA: 0}]");
    EXPECT_TRUE(outcome.complete);
    EXPECT_EQ(outcome.unmet, 1U);
    EXPECT_EQ(heard, (Lines{"1 TA=0 not met 1", "2 TA=0 0", "ended"}));
}

TEST_F(RunnerTest, AnExpectationIsAskedAgainUntilItsTimeIsOver) {
    visa.answersTo = {{coder("TA"), "\"1\"\n"}};
    EXPECT_EQ(play("steps: [expect: {TA: 0, within: 1 s}]").unmet, 1U);
    EXPECT_EQ(writtenAt.size(), 11U);
    for (std::size_t i = 0; i < 10; ++i)
        EXPECT_NEAR(static_cast<double>(writtenAt[i]), static_cast<double>(i) * 100, 5);
}

TEST_F(RunnerTest, AnExpectationEndsWhenItIsMetAndWhatFollowsCountsFromThere) {
    visa.answersTo = {{coder("TA"), "\"1\"\n"}};
    const TrafficListener changing(session.instrument, [this](const Traffic&) {
        if (clock.steadyNow() - begin >= 400ms) visa.answersTo[coder("TA")] = "\"0\"\n";
    });
    EXPECT_EQ(play("steps: [expect: {TA: 0, within: 10 s}, wait: 1 s, send: {TA: 1}]").unmet, 0U);
    EXPECT_NEAR(static_cast<double>(writtenAt.back()), 1600, 60);
}

TEST_F(RunnerTest, APartIsRunFromAStepToAStep) {
    const std::string text =
        "steps: [note: a, {repeat: 3, steps: [note: b, note: c, {sweep: PTY, points: [7, 8], steps: [note: d]}]}, "
        "note: e]";
    struct Part {
        const char *from, *until;
        Lines notes;
    };
    for (const Part& asked : {Part{"3", "", {"3 e"}},
                              {"", "1", {"1 a"}},
                              {"2#3.2", "", {"2#3.2 c", "2#3.3#1.1 d", "2#3.3#2.1 d", "3 e"}},
                              {"2.2", "2.3", {"2#1.2 c", "2#1.3#1.1 d", "2#1.3#2.1 d"}},
                              {"2#3.3#2", "2", {"2#3.3#2.1 d"}},
                              {"2#2", "2#2.1", {"2#2.1 b"}},
                              {"2.3.1", "2.1", {"2#1.3#1.1 d", "2#1.3#2.1 d", "2#2.1 b"}}}) {
        rows.clear();
        EXPECT_TRUE(play(text, part(asked.from, asked.until)).complete);
        Lines notes;
        for (const scenario::Row& row : rows) {
            if (row.key == "note") notes.push_back(row.step + " " + row.value);
        }
        EXPECT_EQ(notes, asked.notes) << asked.from << " " << asked.until;
    }
    EXPECT_NE(std::find(visa.written.begin(), visa.written.end(), direct("PTY=08")), visa.written.end());
}

TEST_F(RunnerTest, APersonsReturnEndsASweepAndTheReportKeepsItsValue) {
    returns = {7s};
    play("steps: [{sweep: HF-Pegel, from: 60, to: 0, step: -1, dwell: 2 s, until: Return}, send: {TA: 1}]");
    EXPECT_EQ(sent(), (Lines{":POW 60DBUV", ":POW 59DBUV", ":POW 58DBUV", ":POW 57DBUV", direct("TA=1")}));
    EXPECT_EQ(heard[4], "1#4 HF-Pegel=57 Return");
    EXPECT_NEAR(static_cast<double>(writtenAt[4]), 7050, 60);
}

TEST_F(RunnerTest, AReturnEndsTheInnermostLoopThatWaitsForIt) {
    returns = {1500ms, 3s};
    play(
        "steps: [{repeat: 5, until: Return, steps: [{sweep: PTY, points: [1, 2, 3], until: Return, dwell: 1 s}, "
        "{repeat: 1, steps: [wait: 10 s]}]}, note: end]");
    EXPECT_EQ(heard, (Lines{"1#1.1#1 PTY=1 0", "1#1.1#2 PTY=2 0", "1#1.1#2 PTY=2 Return", "1#1 repeat=1 Return",
                            "2 note=end ", "ended"}));
}

TEST_F(RunnerTest, ASweepThatNobodyEndsGoesToItsEnd) {
    returns = {0s};
    scenario::RunOptions alone;
    alone.nobodyThere = true;
    play("steps: [{sweep: PTY, points: [1, 2], dwell: 1 s, until: Return}, pause: ready]", alone);
    EXPECT_EQ(heard, (Lines{"1#1 PTY=1 0", "1#2 PTY=2 0", "1#2 PTY=2 no Return", "2 pause=ready --yes", "ended"}));
    EXPECT_EQ(returns.size(), 1U);
}

}  // namespace
}  // namespace kdx::test
