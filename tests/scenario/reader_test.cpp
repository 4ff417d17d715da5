#include "scenario/reader.h"

#include <gtest/gtest.h>

namespace kdx::scenario {
namespace {

using Settings = std::vector<std::pair<std::string, std::string>>;
using namespace std::chrono_literals;

/// The scenario; every problem fails the test.
Scenario reads(const std::string& text, bool force = false) {
    Reading reading = readScenario(text, force);
    for (const Problem& problem : reading.problems)
        ADD_FAILURE() << problem.line << ":" << problem.column << ": " << problem.sentence;
    return std::move(reading.scenario);
}

std::string described(const std::vector<Action>& actions) {
    std::string text;
    for (const Action& action : actions) {
        text += describe(action);
        if (!action.actions.empty()) text += " {" + described(action.actions) + "}";
        text += "; ";
    }
    return text;
}

TEST(ReaderTest, ReadsEverythingThatAScenarioHas) {
    const Scenario scenario = reads(R"(
title: Announcement on another network
data_set: 2
steps:
  - send: {PS: MESSTURM, TP: 1}
  - wait: 2 s
  - send: {EON_TA: 1}
  - expect: {TA: "0", within: 1 s}      # a read-back
  - sweep: HF-Pegel                     # any numeric key
    from: 60
    to: 10
    step: -2                            # or points: [60, 40, 20]
    dwell: 5 s
    steps:
      - send: {TA: 1}
      - wait: 1 s
      - send: {TA: 0}
  - repeat: 10
    steps: [{tmc: "0B90E400CC"}, {wait: 500 ms}]
  - pause: Radio tuned to 98.5 MHz?     # waits for Return; --yes goes on
  - note: second pass
restore: true
report: pass.csv
)");
    EXPECT_EQ(scenario.title, "Announcement on another network");
    EXPECT_EQ(scenario.dataSet, 2);
    EXPECT_TRUE(scenario.restore);
    EXPECT_EQ(scenario.report, "pass.csv");
    EXPECT_EQ(described(scenario.actions),
              "send PS=MESSTURM TP=1; wait 2 s; send EON_TA=1; expect TA=0 within 1 s; "
              "sweep HF-Pegel from 60 to 10, 26 points {send TA=1; wait 1 s; send TA=0; }; "
              "repeat 10 times {tmc 0B90E400CC; wait 500 ms; }; pause: Radio tuned to 98.5 MHz?; note: second pass; ");
    EXPECT_EQ(scenario.actions[4].time, 5s);
}

TEST(ReaderTest, ValuesGoOutAsTheyAreWritten) {
    const Scenario scenario =
        reads("steps:\n- send: {TP: 1, PI: 1E10, PS: 007, RT: true, EON_PS: \"NULL\", DEL_RT: , HF-Frequenz: 98.50}\n");
    EXPECT_EQ(scenario.actions[0].settings, (Settings{{"TP", "1"},
                                                      {"PI", "1E10"},
                                                      {"PS", "007"},
                                                      {"RT", "true"},
                                                      {"EON_PS", "NULL"},
                                                      {"DEL_RT", ""},
                                                      {"HF-Frequenz", "98.50"}}));
}

TEST(ReaderTest, TextsAreUtf8InTheFileAndWindows1252ForTheInstrument) {
    const Scenario scenario =
        reads("\xEF\xBB\xBFtitle: Grüße\nsteps:\r\n- send: {PS: Süd}\r\n- expect: {PS: 'Süd'}\r\n");
    EXPECT_EQ(scenario.title, "Grüße");
    EXPECT_EQ(scenario.actions[0].settings[0].second,
              "S\xFC"
              "d");
    EXPECT_EQ(scenario.actions[1].expected[0].values[0],
              "S\xFC"
              "d");
}

TEST(ReaderTest, TimesHaveFourUnits) {
    const Scenario scenario = reads("steps: [wait: 500 ms, wait: 2s, wait: 1.5 min, wait: 168 h, wait: 0.25 s]");
    std::vector<std::chrono::milliseconds> times;
    for (const Action& action : scenario.actions) times.push_back(action.time);
    EXPECT_EQ(times, (std::vector<std::chrono::milliseconds>{500ms, 2s, 90s, 168h, 250ms}));
}

TEST(ReaderTest, PointsStayAsTheyAreWritten) {
    const Scenario scenario = reads("steps: [{sweep: HF-Pegel, points: [60.0, 40, 20.5], dwell: 1 s, until: Return}]");
    EXPECT_EQ(scenario.actions[0].points, (std::vector<std::string>{"60.0", "40", "20.5"}));
    EXPECT_TRUE(scenario.actions[0].untilReturn);
}

TEST(ReaderTest, AReadBackOfSeveralAnswersExpectsAList) {
    const Scenario scenario = reads("steps: [expect: {pilot: [1, 675, 0], ps: KDX-X4}]");
    EXPECT_EQ(scenario.actions[0].expected[0].values, (std::vector<std::string>{"1", "675", "0"}));
    EXPECT_EQ(scenario.actions[0].expected[1].values, std::vector<std::string>{"KDX-X4"});
}

TEST(ReaderTest, ForcedValuesNeedNotBeLegalButKeysMustBeThere) {
    const std::string text = "steps: [send: {PTY: 99}, {sweep: HF-Pegel, points: [150], dwell: 1 s}]";
    EXPECT_EQ(readScenario(text).problems.size(), 2U);
    EXPECT_EQ(described(reads(text, true).actions), "send PTY=99; sweep HF-Pegel from 150 to 150, 1 points; ");
    EXPECT_EQ(readScenario("steps: [send: {NOKEY: 1}]", true).problems.size(), 1U);
}

TEST(ReaderTest, EightStepsWithinEachOtherAreTaken) {
    std::string inner = "note: x";
    for (int depth = 1; depth < 8; ++depth) inner.insert(0, "{repeat: 2, steps: [").append("]}");
    EXPECT_EQ(reads("steps: [" + inner + "]").actions.size(), 1U);
}

TEST(ReaderTest, AfterManyMistakesTheRestIsLeftOut) {
    std::string text = "steps:\n";
    for (int i = 0; i < 1000; ++i) text += "- wait: 2\n";
    EXPECT_EQ(readScenario(text).problems.size(), 50U);
}

TEST(ReaderTest, ALargeFileIsReadAtOnce) {
    std::string text = "steps:\n";
    while (text.size() < kLargestFile - 100) text += "- {send: {TA: 1}}\n";
    EXPECT_GT(reads(text).actions.size(), 20'000U);
}

}  // namespace
}  // namespace kdx::scenario
