#include "link/instrumenttest.h"

#include <filesystem>

#include "link/commandsequence.h"

namespace kdx::test {
namespace {

using namespace std::string_literals;

TEST_F(InstrumentTest, AWriteSendsTheCommandByteForByte) {
    const std::string command = ":STEREO:DIRECT \"RT=5,1,\xFC\0\t\"\n"s;
    instrument.Send2Gen(command);
    EXPECT_EQ(visa.written, Lines{command});
    EXPECT_EQ(visa.sessions, std::vector<VisaHandle>{kSession});
    EXPECT_EQ(instrument.LastVisaStatus, 0);
    EXPECT_EQ(instrument.LastRetCount, static_cast<std::int32_t>(command.size()));
    EXPECT_TRUE(failures.empty());
}

TEST_F(InstrumentTest, AnEmptyCommandIsWrittenToo) {
    instrument.Send2Gen("");
    EXPECT_EQ(visa.written, Lines{""});
    EXPECT_EQ(instrument.LastRetCount, 0);
}

TEST_F(InstrumentTest, AStoppedSequenceSendsAsksAndLogsNothingMore) {
    visa.writeStatus = visa::kConnectionLost;
    stopAtFailure = true;
    {
        const CommandSequence sequence(instrument);
        instrument.Send2Gen("one");
        EXPECT_TRUE(instrument.isSequenceStopped());
        instrument.Send2Gen("two");
        EXPECT_EQ(instrument.X4_Abfrage("PS?", "PS"), "");
        EXPECT_EQ(instrument.VRN_Abfrage("Freq?", "FREQ"), "");
        EXPECT_EQ(instrument.ReadFromGen(), "Error");
    }
    EXPECT_EQ(visa.written, std::vector<std::string>{"one"});
    EXPECT_EQ(visa.reads, 0);
    EXPECT_EQ(failures.size(), 1U);
    EXPECT_FALSE(instrument.isSequenceStopped());
    instrument.Send2Gen("three");
    EXPECT_EQ(visa.written.back(), "three");
}

TEST_F(InstrumentTest, OutsideASequenceNothingCanBeStopped) {
    visa.writeStatus = visa::kConnectionLost;
    instrument.onFailure([this](const std::string& text, bool) {
        failures.push_back(text);
        return true;
    });
    instrument.Send2Gen("one");
    instrument.Send2Gen("two");
    EXPECT_EQ(failures.size(), 2U);
}

TEST_F(InstrumentTest, AnInnerSequenceDoesNotEndTheStopOfTheOuterOne) {
    visa.writeStatus = visa::kConnectionLost;
    stopAtFailure = true;
    const CommandSequence outer(instrument);
    {
        const CommandSequence inner(instrument);
        instrument.Send2Gen("one");
    }
    instrument.Send2Gen("two");
    EXPECT_EQ(visa.written, std::vector<std::string>{"one"});
}

TEST_F(InstrumentTest, WithoutASessionNothingIsWrittenOrReported) {
    state.InstrumentOnline = false;
    visa.writeStatus = visa::kTimeout;
    instrument.Send2Gen("FM:STAT ON");
    EXPECT_TRUE(visa.written.empty());
    EXPECT_TRUE(failures.empty());
}

TEST_F(InstrumentTest, WithoutASessionAReadGivesAPlaceholderAndLeavesTheLibraryAlone) {
    state.InstrumentOnline = false;
    visa.answers = {"67.5\n"};
    EXPECT_EQ(instrument.ReadFromGen(), kNoSessionAnswer);
    EXPECT_STRNE(kNoSessionAnswer, kReadError) << "callers must not take it for a failed read";
    EXPECT_EQ(visa.reads, 0);
    EXPECT_TRUE(failures.empty());
}

TEST_F(InstrumentTest, AFailedWriteIsReportedOncePerCall) {
    visa.writeStatus = visa::kTimeout;
    instrument.Send2Gen("FM:STAT ON");
    instrument.Send2Gen("FM:STAT OFF");
    EXPECT_EQ(failures, (Lines{"Fehler: -1073807339", "Fehler: -1073807339"}));
    EXPECT_EQ(visa.written, (Lines{"FM:STAT ON", "FM:STAT OFF"})) << "no retry";
    EXPECT_EQ(instrument.LastVisaStatus, visa::kTimeout);
    EXPECT_EQ(instrument.LastRetCount, 0);
}

TEST_F(InstrumentTest, APositiveStatusOfAWriteIsReported) {
    // Stricter than a read on purpose: a warning may mean that the coder did not get the command.
    visa.writeStatus = visa::kMaxCountReached;
    instrument.Send2Gen("FM:STAT ON");
    EXPECT_EQ(failures, Lines{"Fehler: 1073676294"});
    EXPECT_EQ(instrument.LastVisaStatus, visa::kMaxCountReached);
}

TEST_F(InstrumentTest, AnOpeningWithAWarningIsAFailureThatLeavesNothingOpen) {
    constexpr VisaStatus kNotResponding = 0x3FFF007D;
    visa.openStatus = kNotResponding;
    EXPECT_EQ(instrument.open("TCPIP", "lab"), kNotResponding);
    EXPECT_EQ(visa.calls.back(), "viClose " + std::to_string(instrument.InstrSession));
    EXPECT_EQ(instrument.LastVisaStatus, kNotResponding);
    EXPECT_FALSE(instrument.isOpen());
}

TEST_F(InstrumentTest, APositiveStatusOfAReadIsSuccess) {
    visa.answers = {"67.5\n"};
    visa.readStatus = visa::kTermCharacter;
    EXPECT_EQ(instrument.ReadFromGen(), filled("67.5\n"));
    EXPECT_TRUE(failures.empty());
    EXPECT_EQ(instrument.LastVisaStatus, visa::kTermCharacter);
    EXPECT_EQ(instrument.LastRetCount, 5);
}

TEST_F(InstrumentTest, AFailedReadIsReportedAndAnswersError) {
    visa.readStatus = visa::kConnectionLost;
    EXPECT_EQ(instrument.ReadFromGen(), "Error");
    EXPECT_EQ(failures, Lines{"Fehler: -1073807194"});
    EXPECT_EQ(instrument.LastVisaStatus, visa::kConnectionLost);
    EXPECT_EQ(instrument.LastRetCount, 0);
}

TEST_F(InstrumentTest, AnAnswerIsFollowedByTheRestOfTheBuffer) {
    visa.answers = {"67.5\n"};
    const std::string answer = instrument.ReadFromGen();
    EXPECT_EQ(answer, "67.5\n" + std::string(55, ' '));
    EXPECT_EQ(instrument.LastRetCount, 5);
    EXPECT_EQ(visa.sessions, std::vector<VisaHandle>{kSession});
}

TEST_F(InstrumentTest, AnswersOf0And1And60BytesFillTheSame60Characters) {
    for (const std::string& answer : {""s, "x"s, std::string(60, 'x')}) {
        visa.answers = {answer};
        EXPECT_EQ(instrument.ReadFromGen(), filled(answer));
        EXPECT_EQ(instrument.LastRetCount, static_cast<std::int32_t>(answer.size()));
        EXPECT_EQ(instrument.LastVisaStatus, 0);
    }
}

TEST_F(InstrumentTest, WhatDoesNotFitIsReadByTheNextReads) {
    std::string answer;
    for (int i = 0; i < 500; ++i) answer += static_cast<char>('a' + i % 26);
    visa.answers = {answer};
    std::string together;
    for (int i = 0; i < 8; ++i) {
        together += instrument.ReadFromGen();
        EXPECT_EQ(instrument.LastVisaStatus, visa::kMaxCountReached);
        EXPECT_EQ(instrument.LastRetCount, 60);
    }
    together += instrument.ReadFromGen();
    EXPECT_EQ(instrument.LastRetCount, 20);
    EXPECT_EQ(together, answer + std::string(40, ' '));
    EXPECT_TRUE(failures.empty());
}

TEST_F(InstrumentTest, ALogLineIsTheKeyFieldTheValueAndCrLf) {
    instrument.WriteLog("PTY", "1", "");
    EXPECT_EQ(log(), "            PTY= 1\r\n");
}

TEST_F(InstrumentTest, ALogKeyOf3CharactersFollows12Blanks) {
    instrument.WriteLog("PTY", "1", "");
    EXPECT_EQ(log().substr(0, 15), std::string(12, ' ') + "PTY");
}

TEST_F(InstrumentTest, ALongLogKeyKeepsItsLast15Characters) {
    instrument.WriteLog("ABCDEFGHIJKLMNOPQR", "", "");
    instrument.WriteLog("ABCDEFGHIJKLMNO", "", "");
    EXPECT_EQ(log(), "DEFGHIJKLMNOPQR= \r\nABCDEFGHIJKLMNO= \r\n");
}

TEST_F(InstrumentTest, ANoteIsLoggedInDoubleQuotesBehindTheValue) {
    instrument.WriteLog("PTY", "", "PTY=07");
    instrument.WriteLog("PTY", "a", "say \"x\"");
    EXPECT_EQ(log(), "            PTY= \"PTY=07\"\r\n            PTY= a\"say \"x\"\"\r\n");
}

TEST_F(InstrumentTest, EveryByteIsLoggedAsItStands) {
    instrument.WriteLog("RT", "\xFC\n\0\t"s, "");
    EXPECT_EQ(log(), "             RT= \xFC\n\0\t\r\n"s);
}

TEST_F(InstrumentTest, WithLoggingOffNoLogIsCreated) {
    state.LogEnabled = false;
    instrument.WriteLog("PTY", "1", "");
    EXPECT_FALSE(std::filesystem::exists(folder.data() / kCommandLog));
}

TEST_F(InstrumentTest, AnObserverHearsOfEveryLineEvenWithLoggingOff) {
    state.LogEnabled = false;
    Lines heard;
    const TrafficListener listener(instrument, [&](const Traffic& traffic) { heard.push_back(traffic.text); });
    Lines heardToo;
    const TrafficListener another(instrument, [&](const Traffic& traffic) { heardToo.push_back(traffic.text); });
    visa.answers = {"67.5\n"};
    instrument.Send2Gen("FREQ?");
    instrument.WriteLog("PTY", "1", "x");
    instrument.ReadFromGen();
    EXPECT_EQ(heard, (Lines{"FREQ?", "            PTY= 1\"x\"", filled("67.5\n")}));
    EXPECT_EQ(heardToo, heard);
}

TEST_F(InstrumentTest, TheLogIsFoundInAnyLetterCaseAndEmptied) {
    if (!folder.tellsLetterCaseApart()) GTEST_SKIP() << "names of files have no letter case here";
    folder.write("RDS_Log.txt", "old\r\n");
    instrument.WriteLog("PTY", "1", "");
    EXPECT_EQ(folder.read("RDS_Log.txt"), "old\r\n            PTY= 1\r\n");
    instrument.log.empty();
    EXPECT_EQ(folder.read("RDS_Log.txt"), "");
    EXPECT_FALSE(std::filesystem::exists(folder.data() / kCommandLog));
}

TEST_F(InstrumentTest, EmptyingCreatesTheLog) {
    instrument.log.empty();
    EXPECT_TRUE(std::filesystem::exists(folder.data() / kCommandLog));
    EXPECT_EQ(log(), "");
}

TEST_F(InstrumentTest, TheLogMayBeDeletedBetweenTwoLines) {
    instrument.WriteLog("PS", "1", "");
    std::filesystem::remove(folder.data() / kCommandLog);
    instrument.WriteLog("PI", "2", "");
    EXPECT_EQ(log(), "             PI= 2\r\n");
}

TEST_F(InstrumentTest, ALogThatCannotBeWrittenStopsNothing) {
    std::filesystem::remove_all(folder.data());
    instrument.log.empty();
    EXPECT_EQ(askCoder("\"RADIO\"\n"), "RADIO");
    EXPECT_EQ(visa.written.size(), 1U);
    EXPECT_TRUE(failures.empty());
    EXPECT_FALSE(std::filesystem::exists(folder.data()));
}

TEST_F(InstrumentTest, AFolderInTheLogsPlaceStopsNothing) {
    std::filesystem::create_directory(folder.data() / kCommandLog);
    instrument.log.empty();
    EXPECT_EQ(askCoder("\"RADIO\"\n"), "RADIO");
    EXPECT_TRUE(failures.empty());
}

}  // namespace
}  // namespace kdx::test
