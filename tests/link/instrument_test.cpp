#include "link/instrument.h"

#include <gtest/gtest.h>

#include <cmath>
#include <filesystem>
#include <vector>

#include "settings/datafolder.h"
#include "settings/programstate.h"
#include "support/fakeclock.h"
#include "support/fakevisa.h"
#include "support/tempfolder.h"

namespace kdx {
namespace {

using namespace std::string_literals;
using Lines = std::vector<std::string>;

constexpr VisaHandle kSession = 17;

/// An answer as ReadFromGen gives it: filled with blanks to the buffer's 60 characters.
std::string filled(std::string answer) {
    answer.resize(60, ' ');
    return answer;
}

class InstrumentTest : public ::testing::Test {
protected:
    InstrumentTest() {
        m_state.InstrumentOnline = true;
        m_state.LogEnabled = true;
        m_instrument.InstrSession = kSession;
        m_instrument.setCaptionSource([](int number) { return "<" + std::to_string(number) + ">"; });
    }
    [[nodiscard]] std::string log() const { return m_folder.read(kCommandLog); }
    [[nodiscard]] std::string askCoder(const std::string& answer) {
        m_visa.answers = {answer};
        return m_instrument.X4_Abfrage("PS", "PS?");
    }
    [[nodiscard]] std::string askGenerator(const std::string& answer) {
        m_visa.answers = {answer};
        return m_instrument.VRN_Abfrage("HF", "FREQ");
    }

    test::TempFolder m_folder;
    test::FakeClock m_clock{100};
    test::FakeVisa m_visa;
    ProgramState m_state;
    DataFolder m_data{m_folder.path()};
    Lines m_errors;
    bool m_stopAtFailure = false;  // press the button that stops the running sequence
    Instrument m_instrument{m_visa, m_state, m_data, m_clock, [this](const auto& text, bool sequence) {
                                m_errors.push_back(text);
                                return sequence && m_stopAtFailure;
                            }};
};

TEST_F(InstrumentTest, AWriteSendsTheCommandByteForByte) {
    const std::string command = ":STEREO:DIRECT \"RT=5,1,\xFC\0\t\"\n"s;
    m_instrument.Send2Gen(command);
    EXPECT_EQ(m_visa.written, Lines{command});
    EXPECT_EQ(m_visa.sessions, std::vector<VisaHandle>{kSession});
    EXPECT_EQ(m_instrument.LastVisaStatus, 0);
    EXPECT_EQ(m_instrument.LastRetCount, static_cast<std::int32_t>(command.size()));
    EXPECT_TRUE(m_errors.empty());
}

TEST_F(InstrumentTest, AnEmptyCommandIsWrittenToo) {
    m_instrument.Send2Gen("");
    EXPECT_EQ(m_visa.written, Lines{""});
    EXPECT_EQ(m_instrument.LastRetCount, 0);
}

TEST_F(InstrumentTest, AStoppedSequenceSendsAsksAndLogsNothingMore) {
    m_visa.writeStatus = visa::kConnectionLost;
    m_stopAtFailure = true;
    {
        const CommandSequence sequence(m_instrument);
        m_instrument.Send2Gen("one");
        EXPECT_TRUE(m_instrument.isSequenceStopped());
        m_instrument.Send2Gen("two");
        EXPECT_EQ(m_instrument.X4_Abfrage("PS?", "PS"), "");
        EXPECT_EQ(m_instrument.VRN_Abfrage("Freq?", "FREQ"), "");
        EXPECT_EQ(m_instrument.ReadFromGen(), "Error");
    }
    EXPECT_EQ(m_visa.written, std::vector<std::string>{"one"});
    EXPECT_EQ(m_visa.reads, 0);
    EXPECT_EQ(m_errors.size(), 1U);
    EXPECT_FALSE(m_instrument.isSequenceStopped());
    m_instrument.Send2Gen("three");
    EXPECT_EQ(m_visa.written.back(), "three");
}

TEST_F(InstrumentTest, OutsideASequenceNothingCanBeStopped) {
    m_visa.writeStatus = visa::kConnectionLost;
    m_stopAtFailure = true;
    m_instrument.Send2Gen("one");
    m_instrument.Send2Gen("two");
    EXPECT_EQ(m_errors.size(), 2U);
}

TEST_F(InstrumentTest, AnInnerSequenceDoesNotEndTheStopOfTheOuterOne) {
    m_visa.writeStatus = visa::kConnectionLost;
    m_stopAtFailure = true;
    const CommandSequence outer(m_instrument);
    {
        const CommandSequence inner(m_instrument);
        m_instrument.Send2Gen("one");
    }
    m_instrument.Send2Gen("two");
    EXPECT_EQ(m_visa.written, std::vector<std::string>{"one"});
}

TEST_F(InstrumentTest, WithoutASessionNothingIsWrittenOrReported) {
    m_state.InstrumentOnline = false;
    m_visa.writeStatus = visa::kTimeout;
    m_instrument.Send2Gen("FM:STAT ON");
    EXPECT_TRUE(m_visa.written.empty());
    EXPECT_TRUE(m_errors.empty());
}

TEST_F(InstrumentTest, WithoutASessionAReadGivesAPlaceholderAndLeavesTheLibraryAlone) {
    m_state.InstrumentOnline = false;
    m_visa.answers = {"67.5\n"};
    EXPECT_EQ(m_instrument.ReadFromGen(), kNoSessionAnswer);
    EXPECT_STRNE(kNoSessionAnswer, kReadError) << "callers must not take it for a failed read";
    EXPECT_EQ(m_visa.reads, 0);
    EXPECT_TRUE(m_errors.empty());
}

TEST_F(InstrumentTest, AFailedWriteIsReportedOncePerCall) {
    m_visa.writeStatus = visa::kTimeout;
    m_instrument.Send2Gen("FM:STAT ON");
    m_instrument.Send2Gen("FM:STAT OFF");
    EXPECT_EQ(m_errors, (Lines{"Fehler: -1073807339", "Fehler: -1073807339"}));
    EXPECT_EQ(m_visa.written, (Lines{"FM:STAT ON", "FM:STAT OFF"})) << "no retry";
    EXPECT_EQ(m_instrument.LastVisaStatus, visa::kTimeout);
    EXPECT_EQ(m_instrument.LastRetCount, 0);
}

TEST_F(InstrumentTest, APositiveStatusOfAWriteIsReported) {
    // Stricter than a read on purpose: a warning may mean that the coder did not get the command.
    m_visa.writeStatus = visa::kMaxCountReached;
    m_instrument.Send2Gen("FM:STAT ON");
    EXPECT_EQ(m_errors, Lines{"Fehler: 1073676294"});
    EXPECT_EQ(m_instrument.LastVisaStatus, visa::kMaxCountReached);
}

TEST_F(InstrumentTest, APositiveStatusOfAReadIsSuccess) {
    m_visa.answers = {"67.5\n"};
    m_visa.readStatus = visa::kTermCharacter;
    EXPECT_EQ(m_instrument.ReadFromGen(), filled("67.5\n"));
    EXPECT_TRUE(m_errors.empty());
    EXPECT_EQ(m_instrument.LastVisaStatus, visa::kTermCharacter);
    EXPECT_EQ(m_instrument.LastRetCount, 5);
}

TEST_F(InstrumentTest, AFailedReadIsReportedAndAnswersError) {
    m_visa.readStatus = visa::kConnectionLost;
    EXPECT_EQ(m_instrument.ReadFromGen(), "Error");
    EXPECT_EQ(m_errors, Lines{"Fehler: -1073807194"});
    EXPECT_EQ(m_instrument.LastVisaStatus, visa::kConnectionLost);
    EXPECT_EQ(m_instrument.LastRetCount, 0);
}

TEST_F(InstrumentTest, AnAnswerIsFollowedByTheRestOfTheBuffer) {
    m_visa.answers = {"67.5\n"};
    const std::string answer = m_instrument.ReadFromGen();
    EXPECT_EQ(answer, "67.5\n" + std::string(55, ' '));
    EXPECT_EQ(m_instrument.LastRetCount, 5);
    EXPECT_EQ(m_visa.sessions, std::vector<VisaHandle>{kSession});
}

TEST_F(InstrumentTest, AnswersOf0And1And60BytesFillTheSame60Characters) {
    for (const std::string& answer : {""s, "x"s, std::string(60, 'x')}) {
        m_visa.answers = {answer};
        EXPECT_EQ(m_instrument.ReadFromGen(), filled(answer));
        EXPECT_EQ(m_instrument.LastRetCount, static_cast<std::int32_t>(answer.size()));
        EXPECT_EQ(m_instrument.LastVisaStatus, 0);
    }
}

TEST_F(InstrumentTest, WhatDoesNotFitIsReadByTheNextReads) {
    std::string answer;
    for (int i = 0; i < 500; ++i) answer += static_cast<char>('a' + i % 26);
    m_visa.answers = {answer};
    std::string together;
    for (int i = 0; i < 8; ++i) {
        together += m_instrument.ReadFromGen();
        EXPECT_EQ(m_instrument.LastVisaStatus, visa::kMaxCountReached);
        EXPECT_EQ(m_instrument.LastRetCount, 60);
    }
    together += m_instrument.ReadFromGen();
    EXPECT_EQ(m_instrument.LastRetCount, 20);
    EXPECT_EQ(together, answer + std::string(40, ' '));
    EXPECT_TRUE(m_errors.empty());
}

TEST_F(InstrumentTest, ALogLineIsTheKeyFieldTheValueAndCrLf) {
    m_instrument.WriteLog("PTY", "1", "");
    EXPECT_EQ(log(), "            PTY= 1\r\n");
}

TEST_F(InstrumentTest, ALogKeyOf3CharactersFollows12Blanks) {
    m_instrument.WriteLog("PTY", "1", "");
    EXPECT_EQ(log().substr(0, 15), std::string(12, ' ') + "PTY");
}

TEST_F(InstrumentTest, ALongLogKeyKeepsItsLast15Characters) {
    m_instrument.WriteLog("ABCDEFGHIJKLMNOPQR", "", "");
    m_instrument.WriteLog("ABCDEFGHIJKLMNO", "", "");
    EXPECT_EQ(log(), "DEFGHIJKLMNOPQR= \r\nABCDEFGHIJKLMNO= \r\n");
}

TEST_F(InstrumentTest, ANoteIsLoggedInDoubleQuotesBehindTheValue) {
    m_instrument.WriteLog("PTY", "", "PTY=07");
    m_instrument.WriteLog("PTY", "a", "say \"x\"");
    EXPECT_EQ(log(), "            PTY= \"PTY=07\"\r\n            PTY= a\"say \"x\"\"\r\n");
}

TEST_F(InstrumentTest, EveryByteIsLoggedAsItStands) {
    m_instrument.WriteLog("RT", "\xFC\n\0\t"s, "");
    EXPECT_EQ(log(), "             RT= \xFC\n\0\t\r\n"s);
}

TEST_F(InstrumentTest, WithLoggingOffNoLogIsCreated) {
    m_state.LogEnabled = false;
    m_instrument.WriteLog("PTY", "1", "");
    EXPECT_TRUE(std::filesystem::is_empty(m_folder.data()));
}

TEST_F(InstrumentTest, AnObserverHearsOfEveryLineEvenWithLoggingOff) {
    m_state.LogEnabled = false;
    Lines heard;
    m_instrument.onTraffic([&](const Traffic& traffic) { heard.push_back(traffic.text); });
    m_visa.answers = {"67.5\n"};
    m_instrument.Send2Gen("FREQ?");
    m_instrument.WriteLog("PTY", "1", "x");
    m_instrument.ReadFromGen();
    EXPECT_EQ(heard, (Lines{"FREQ?", "            PTY= 1\"x\"", filled("67.5\n")}));
}

TEST_F(InstrumentTest, TheLogIsFoundInAnyLetterCaseAndEmptied) {
    m_folder.write("RDS_Log.txt", "old\r\n");
    m_instrument.WriteLog("PTY", "1", "");
    EXPECT_EQ(m_folder.read("RDS_Log.txt"), "old\r\n            PTY= 1\r\n");
    m_instrument.emptyLog();
    EXPECT_EQ(m_folder.read("RDS_Log.txt"), "");
    EXPECT_FALSE(std::filesystem::exists(m_folder.data() / kCommandLog));
}

TEST_F(InstrumentTest, EmptyingCreatesTheLog) {
    m_instrument.emptyLog();
    EXPECT_TRUE(std::filesystem::exists(m_folder.data() / kCommandLog));
    EXPECT_EQ(log(), "");
}

TEST_F(InstrumentTest, TheLogMayBeDeletedBetweenTwoLines) {
    m_instrument.WriteLog("PS", "1", "");
    std::filesystem::remove(m_folder.data() / kCommandLog);
    m_instrument.WriteLog("PI", "2", "");
    EXPECT_EQ(log(), "             PI= 2\r\n");
}

TEST_F(InstrumentTest, ALogThatCannotBeWrittenStopsNothing) {
    std::filesystem::remove_all(m_folder.data());
    m_instrument.emptyLog();
    EXPECT_EQ(askCoder("\"RADIO\"\n"), "RADIO");
    EXPECT_EQ(m_visa.written.size(), 1U);
    EXPECT_TRUE(m_errors.empty());
    EXPECT_FALSE(std::filesystem::exists(m_folder.data()));
}

TEST_F(InstrumentTest, AFolderInTheLogsPlaceStopsNothing) {
    std::filesystem::create_directory(m_folder.data() / kCommandLog);
    m_instrument.emptyLog();
    EXPECT_EQ(askCoder("\"RADIO\"\n"), "RADIO");
    EXPECT_TRUE(m_errors.empty());
}

TEST_F(InstrumentTest, AFullDiskUnderTheLogStopsNothing) {
    std::filesystem::create_symlink("/dev/full", m_folder.data() / kCommandLog);
    EXPECT_EQ(askCoder("\"RADIO\"\n"), "RADIO");
    EXPECT_TRUE(m_errors.empty());
}

TEST_F(InstrumentTest, ACoderQueryTakesTheQuotesOffAndWritesThreeLines) {
    EXPECT_EQ(askCoder("\"RADIO\"\n"), "RADIO");
    EXPECT_EQ(m_visa.written, Lines{R"(:STEREO:DIRECT? "PS?")"});
    EXPECT_EQ(log(),
              "             PS= :STEREO:DIRECT? \"PS?\"\r\n"
              "             PS= Answer \"" +
                  filled("\"RADIO\"\n") +
                  "\"\r\n"
                  "          <142>= RADIO\r\n");
}

TEST_F(InstrumentTest, AGeneratorQueryKeepsTheAnswerAndWritesThreeLines) {
    EXPECT_EQ(askGenerator("87600000\n"), "87600000");
    EXPECT_EQ(m_visa.written, Lines{"FREQ?"});
    EXPECT_EQ(log(),
              "             HF= :? \"FREQ\"\r\n"
              "             HF= Answer \"" +
                  filled("87600000\n") +
                  "\"\r\n"
                  "          <142>= 87600000\r\n");
}

TEST_F(InstrumentTest, BothQueriesLogTheQuestionPauseAndThenRead) {
    Lines events;
    m_instrument.onTraffic([&](const Traffic& traffic) {
        const char* what = traffic.kind == Traffic::Kind::Written ? "write " : "read ";
        if (traffic.kind == Traffic::Kind::Logged) what = "log ";
        events.push_back(what + std::to_string(std::lround(m_clock.sleptMs())));
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
    EXPECT_TRUE(m_errors.empty());
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
    m_visa.readStatus = visa::kTimeout;
    EXPECT_EQ(askCoder("\"RADIO\"\n"), "");
    EXPECT_EQ(askGenerator("67.5\n"), "");
    EXPECT_EQ(log(),
              "             PS= :STEREO:DIRECT? \"PS?\"\r\n"
              "             PS= Answer \"Error\"\r\n"
              "             HF= :? \"FREQ\"\r\n"
              "             HF= Answer \"Error\"\r\n");
    EXPECT_EQ(m_errors, (Lines{"Fehler: -1073807339", "Fehler: -1073807339"}));
}

TEST_F(InstrumentTest, AFailedQuestionIsReportedAndTheAnswerReadAllTheSame) {
    m_visa.writeStatus = visa::kInputOutput;
    EXPECT_EQ(askCoder("\"RADIO\"\n"), "RADIO");
    EXPECT_EQ(m_errors, Lines{"Fehler: -1073807298"});
    EXPECT_EQ(m_visa.reads, 1);
}

TEST_F(InstrumentTest, WithoutASessionAQueryReachesNobody) {
    m_state.InstrumentOnline = false;
    EXPECT_EQ(askGenerator("67.5\n"), kNoSessionAnswer);
    EXPECT_TRUE(m_visa.written.empty());
    EXPECT_EQ(m_visa.reads, 0);
    EXPECT_TRUE(m_errors.empty());
}

TEST_F(InstrumentTest, WithoutCaptionsTheDisplayLineHasAnEmptyKey) {
    m_instrument.setCaptionSource({});
    EXPECT_EQ(askGenerator("\n"), "FREQ ");
    EXPECT_TRUE(log().ends_with("               = FREQ \r\n"));
}

}  // namespace
}  // namespace kdx
