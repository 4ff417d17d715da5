#include "link/instrumenttest.h"

#include <filesystem>

namespace kdx::test {
namespace {

using namespace std::string_literals;

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

}  // namespace
}  // namespace kdx::test
