#include "sim/simtest.h"

namespace kdx::sim {
namespace {

class StatusTest : public SimTest {};

TEST_F(StatusTest, IdentificationIsTheOneHandedIn) {
    EXPECT_EQ(tell("*IDN?"), "KDX,KDX-X4,100001,1.00\n");
    VirtualInstrument named(clock, "A,B,C,D");
    EXPECT_EQ(named.execute("*idn?\r\n"), "A,B,C,D\n");
}

TEST_F(StatusTest, EventRegisterTellsPowerOnThenTheKindsOfErrorsAndIsClearedByReading) {
    EXPECT_EQ(ask("*ESR?"), "128");
    EXPECT_EQ(ask("*ESR?"), "0");
    tell("NONSENSE");
    EXPECT_EQ(ask("*ESR?"), "32");
    tell("FREQ 5GHZ");
    EXPECT_EQ(ask("*ESR?"), "16");
    instrument.report(ScpiError::QueryUnterminated);
    EXPECT_EQ(ask("*ESR?"), "4");
    tell("*OPC");
    EXPECT_EQ(ask("*ESR?"), "1");
}

TEST_F(StatusTest, ClearEmptiesErrorsAndEvents) {
    tell("NONSENSE;*CLS");
    EXPECT_EQ(error(), 0);
    EXPECT_EQ(ask("*ESR?"), "0");
}

TEST_F(StatusTest, ResetBringsBackTheSettingsAndLeavesErrors) {
    tell("FREQ 99.9MHZ;:OUTPUT:STAT ON;:STEREO:STATE ON;NONSENSE");
    coder("PS=OTHER");
    coder("CT=10:00:00,01.02.09");
    coder("8A=02,0810013039");
    coder("EON-PI=D3C2");
    EXPECT_EQ(tell("*RST"), "");
    EXPECT_EQ(ask("FREQ?;:OUTPUT:STAT?;:STEREO:STATE?"), "100;0;0");
    EXPECT_EQ(askCoder("PS"), "\"KDX-X4  \"");
    EXPECT_EQ(askCoder("CT"), "\"off\"");
    EXPECT_EQ(askCoder("8A-N"), "\"0\"");
    EXPECT_EQ(askCoder("EON-PI"), "\" \"");
    EXPECT_EQ(error(), -113);
}

TEST_F(StatusTest, DeviceClearLeavesSettingsAndErrorsAlone) {
    tell("FREQ 99.9MHZ;NONSENSE");
    instrument.clear();
    EXPECT_EQ(ask("FREQ?"), "99.9");
    EXPECT_EQ(error(), -113);
}

TEST_F(StatusTest, EventEnableAndServiceEnableAreKeptThroughAReset) {
    EXPECT_EQ(ask("*ESE?;*SRE?"), "0;0");
    tell("*ESE 60;*SRE 36.4");
    EXPECT_EQ(ask("*ESE?;*SRE?"), "60;36");
    tell("*RST;*CLS");
    EXPECT_EQ(ask("*ESE?;*SRE?"), "60;36");
    tell("*SRE 255");
    EXPECT_EQ(ask("*SRE?"), "191") << "the summary bit cannot be its own cause";
    for (const char* command : {"*ESE 256", "*ESE -1", "*SRE 300"}) {
        tell(command);
        EXPECT_EQ(error(), -222) << command;
    }
    for (const auto& [command, code] : {std::pair{"*ESE", -109}, {"*ESE x", -224}, {"*SRE 1HZ", -131}}) {
        tell(command);
        EXPECT_EQ(error(), code) << command;
    }
    EXPECT_EQ(ask("*ESE?;*SRE?"), "60;191");
}

TEST_F(StatusTest, StatusByteTellsOfErrorsUntilTheyAreReadAndOfEventsThatAreEnabled) {
    EXPECT_EQ(instrument.statusByte(false), 0);
    tell("NONSENSE");
    EXPECT_EQ(instrument.statusByte(false), 4);
    tell("*ESE 16");
    EXPECT_EQ(instrument.statusByte(false), 4) << "a command error is not enabled";
    tell("*ESE 32");
    EXPECT_EQ(instrument.statusByte(false), 4 + 32);
    EXPECT_EQ(ask("*STB?"), "36");
    EXPECT_EQ(error(), -113);
    EXPECT_EQ(instrument.statusByte(false), 32);
    tell("*ESR?");
    EXPECT_EQ(instrument.statusByte(false), 0);
}

TEST_F(StatusTest, StatusByteHasTheMasterSummaryOfWhatServiceIsEnabledFor) {
    tell("*ESE 32;*SRE 32;NONSENSE");
    EXPECT_EQ(ask("*STB?"), "100");
    tell("*SRE 16");
    EXPECT_EQ(ask("*STB?"), "36");
    EXPECT_EQ(instrument.statusByte(true), 4 + 16 + 32 + 64);
    EXPECT_EQ(ask("*OPC?;*STB?"), "1;116") << "the first answer waits already";
}

TEST_F(StatusTest, OperationAndQuestionableRegistersHaveNothingToTell) {
    for (const std::string group : {"STAT:OPER", "STATUS:QUESTIONABLE"}) {
        std::string questions = group + "?;:";
        questions.append(group).append(":EVEN?;COND?;ENAB?");
        EXPECT_EQ(ask(questions), "0;0;0;0");
        tell(group + ":ENAB 32769");
        EXPECT_EQ(ask(group + ":ENABLE?"), "1") << "the highest bit is not used";
        tell(group + ":ENABLE 65536");
        EXPECT_EQ(error(), -222);
    }
    tell("STATUS:PRESET");
    EXPECT_EQ(ask("STAT:OPER:ENAB?;:STAT:QUES:ENAB?"), "0;0");
}

TEST_F(StatusTest, TransitionFiltersAreKeptUntilThePreset) {
    for (const std::string group : {"STAT:OPER", "STATUS:QUESTIONABLE"}) {
        EXPECT_EQ(ask(group + ":PTR?;NTR?"), "32767;0") << group;
        tell(group + ":PTRansition 5;NTRANSITION 65535");
        EXPECT_EQ(ask(group + ":PTR?;NTR?"), "5;32767") << "the highest bit is not used";
        tell("*RST;*CLS");
        EXPECT_EQ(ask(group + ":PTR?;NTR?"), "5;32767") << group;
        for (const char* command : {":PTR 65536", ":NTR -1"}) {
            tell(group + command);
            EXPECT_EQ(error(), -222) << command;
        }
    }
    tell("STAT:OPER:PTR 6");
    EXPECT_EQ(ask("STAT:OPER:PTR?;:STAT:QUES:PTR?"), "6;5") << "each has its own";
    tell("STATUS:PRESET");
    EXPECT_EQ(ask("STAT:OPER:PTR?;NTR?;:STAT:QUES:PTR?;NTR?"), "32767;0;32767;0");
    EXPECT_EQ(error(), 0);
}

TEST_F(StatusTest, RegistersTakeTheWordsForTheEndsOfARangeAndForTheDefault) {
    tell("*ESE MAX;*SRE maximum;:STAT:OPER:ENAB MAX;:STAT:QUES:NTR MAX;PTR MIN");
    EXPECT_EQ(ask("*ESE?;*SRE?;:STAT:OPER:ENAB?;:STAT:QUES:NTR?;PTR?"), "255;191;32767;32767;0");
    tell("*ESE MIN;*SRE DEF;:STAT:OPER:ENAB DEFAULT;:STAT:QUES:NTR DEF;PTR DEF");
    EXPECT_EQ(ask("*ESE?;*SRE?;:STAT:OPER:ENAB?;:STAT:QUES:NTR?;PTR?"), "0;0;0;0;32767");
    EXPECT_EQ(ask("*ESE? MAX;*SRE? MAX;:STAT:OPER:ENAB? MAX;:STAT:QUES:PTR? MIN;PTR? DEF"), "255;191;32767;0;32767");
    EXPECT_EQ(error(), 0);
    for (const auto& [message, code] : {std::pair{"*ESE MAXI", -224}, {"*ESE? 5", -108}, {"*ESR? MAX", -108}}) {
        EXPECT_EQ(tell(message), "") << message;
        EXPECT_EQ(error(), code) << message;
    }
}

TEST_F(StatusTest, DriversGetTheAnswersTheyExpect) {
    EXPECT_EQ(ask("*TST?"), "0");
    EXPECT_EQ(ask("SYST:VERS?"), "1999.0");
    EXPECT_EQ(tell("*WAI"), "");
    EXPECT_EQ(ask("SYST:ERR?;VERS?"), "0,\"No error\";1999.0");
    EXPECT_EQ(error(), 0);
}

}  // namespace
}  // namespace kdx::sim
