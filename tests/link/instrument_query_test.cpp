#include "link/instrumenttest.h"

#include <cmath>

namespace kdx::test {
namespace {

using namespace std::string_literals;

TEST_F(InstrumentTest, ACoderQueryTakesTheQuotesOffAndWritesThreeLines) {
    EXPECT_EQ(askCoder("\"RADIO\"\n"), "RADIO");
    EXPECT_EQ(visa.written, Lines{R"(:STEREO:DIRECT? "PS?")"});
    EXPECT_EQ(log(),
              "             PS= :STEREO:DIRECT? \"PS?\"\r\n"
              "             PS= Answer \"" +
                  filled("\"RADIO\"\n") +
                  "\"\r\n"
                  "          <142>= RADIO\r\n");
}

TEST_F(InstrumentTest, AGeneratorQueryKeepsTheAnswerAndWritesThreeLines) {
    EXPECT_EQ(askGenerator("87600000\n"), "87600000");
    EXPECT_EQ(visa.written, Lines{"FREQ?"});
    EXPECT_EQ(log(),
              "             HF= :? \"FREQ\"\r\n"
              "             HF= Answer \"" +
                  filled("87600000\n") +
                  "\"\r\n"
                  "          <142>= 87600000\r\n");
}

TEST_F(InstrumentTest, BothQueriesLogTheQuestionPauseAndThenRead) {
    Lines events;
    const TrafficListener listener(instrument, [&](const Traffic& traffic) {
        const char* what = traffic.kind == Traffic::Kind::Written ? "write " : "read ";
        if (traffic.kind == Traffic::Kind::Logged) what = "log ";
        events.push_back(what + std::to_string(std::lround(clock.sleptMs())));
    });
    EXPECT_EQ(askCoder("\"1\"\n"), "1");
    EXPECT_EQ(askGenerator("1\n"), "1");
    EXPECT_EQ(events, (Lines{"write 0", "log 0", "read 50", "log 50", "log 50",  //
                             "write 50", "log 50", "read 100", "log 100", "log 100"}));
}

TEST_F(InstrumentTest, TwoQuotesShowAsEmptyValue) {
    EXPECT_EQ(askCoder("\"\"\n"), "PS?: <144> | ");
}

TEST_F(InstrumentTest, ASingleCharacterIsShownAsItIs) {
    EXPECT_EQ(askCoder("7\n"), "7");
    EXPECT_EQ(askCoder("\"\n"), "\"");
}

TEST_F(InstrumentTest, AnswersWithoutQuotesLoseTheirEndsToo) {
    // The coder always quotes; the ends are not looked at.
    EXPECT_EQ(askCoder("ABCD\n"), "BC");
    EXPECT_EQ(askCoder("AB\n"), "");
}

TEST_F(InstrumentTest, ALineFeedAloneShowsAsEmptyTextForTheCoderAndAsNoAnswerForTheGenerator) {
    // The two test for emptiness at different points, one before and one after the cut: kept as it is.
    EXPECT_EQ(askCoder("\n"), "");
    EXPECT_EQ(askGenerator("\n"), "FREQ <143>");
}

TEST_F(InstrumentTest, OnlyTheTextBeforeTheFirstLineFeedCounts) {
    EXPECT_EQ(askCoder("\"A\"\n\"B\"\n"), "A");
    EXPECT_EQ(askGenerator("A\nB\n"), "A");
}

TEST_F(InstrumentTest, AnAnswerOfNoBytesIsAFieldOfBlanks) {
    EXPECT_EQ(askCoder(""), std::string(58, ' '));
    EXPECT_EQ(askGenerator(""), std::string(60, ' '));
}

TEST_F(InstrumentTest, AnAnswerOfOneByteWithoutALineFeedKeepsTheBlanksOfTheBuffer) {
    EXPECT_EQ(askCoder("7"), std::string(58, ' '));
    EXPECT_EQ(askGenerator("7"), "7" + std::string(59, ' '));
}

TEST_F(InstrumentTest, AnAnswerOf60BytesIsTakenWhole) {
    const std::string text(58, 'x');
    EXPECT_EQ(askCoder("\"" + text + "\""), text);
    EXPECT_EQ(askGenerator(std::string(60, 'x')), std::string(60, 'x'));
}

TEST_F(InstrumentTest, AnAnswerOf500BytesShowsItsFirst60) {
    const std::string text(498, 'x');
    EXPECT_EQ(askCoder("\"" + text + "\""), std::string(58, 'x'));
    EXPECT_EQ(askGenerator(std::string(500, 'y')), std::string(60, 'y'));
    EXPECT_TRUE(failures.empty());
}

TEST_F(InstrumentTest, ControlCharactersAreTextLikeAnyOther) {
    EXPECT_EQ(askCoder("\"a\0\r\t\x1B\xFF\"\n"s), "a\0\r\t\x1B\xFF"s);
    EXPECT_EQ(askGenerator("a\0\r\t\x1B\xFF\n"s), "a\0\r\t\x1B\xFF"s);
}

TEST_F(InstrumentTest, ACarriageReturnBeforeTheLineFeedIsTakenForTheClosingQuote) {
    EXPECT_EQ(askCoder("\"RADIO\"\r\n"), "RADIO\"");
    EXPECT_EQ(askGenerator("67.5\r\n"), "67.5\r");
}

TEST_F(InstrumentTest, AFailedReadGivesNoTextAndNoDisplayLine) {
    visa.readStatus = visa::kTimeout;
    EXPECT_EQ(askCoder("\"RADIO\"\n"), "");
    EXPECT_EQ(askGenerator("67.5\n"), "");
    EXPECT_EQ(log(),
              "             PS= :STEREO:DIRECT? \"PS?\"\r\n"
              "             PS= Answer \"Error\"\r\n"
              "             HF= :? \"FREQ\"\r\n"
              "             HF= Answer \"Error\"\r\n");
    EXPECT_EQ(failures, (Lines{"Fehler: -1073807339", "Fehler: -1073807339"}));
}

TEST_F(InstrumentTest, AFailedQuestionIsReportedAndTheAnswerReadAllTheSame) {
    visa.writeStatus = visa::kInputOutput;
    EXPECT_EQ(askCoder("\"RADIO\"\n"), "RADIO");
    EXPECT_EQ(failures, Lines{"Fehler: -1073807298"});
    EXPECT_EQ(visa.reads, 1);
}

TEST_F(InstrumentTest, WithoutASessionAQueryReachesNobody) {
    state.InstrumentOnline = false;
    EXPECT_EQ(askGenerator("67.5\n"), kNoSessionAnswer);
    EXPECT_TRUE(visa.written.empty());
    EXPECT_EQ(visa.reads, 0);
    EXPECT_TRUE(failures.empty());
}

TEST_F(InstrumentTest, WithoutCaptionsTheDisplayLineHasAnEmptyKey) {
    captions.load("another", "RDS");  // which the file does not have
    EXPECT_EQ(askGenerator("\n"), "FREQ ");
    EXPECT_TRUE(log().ends_with("               = FREQ \r\n"));
}

}  // namespace
}  // namespace kdx::test
