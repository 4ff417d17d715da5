#include "coder/sendparam.h"

#include <gtest/gtest.h>

#include <cctype>
#include <cmath>
#include <ostream>
#include <stdexcept>
#include <vector>

#include "support/linkfixture.h"

namespace kdx {
namespace {

using namespace std::string_literals;
using test::Lines;

/// What a key and a value become.
struct CommandCase {
    const char* key;
    std::string value;
    std::string command;
    friend void PrintTo(const CommandCase& sent, std::ostream* out) { *out << sent.key; }
};

const ParamContext kContext{"D3C0", "08:15:30", "23:59:58", "05.03.09"};

class ComposeCommand : public ::testing::TestWithParam<CommandCase> {};

TEST_P(ComposeCommand, GivesExactlyTheseBytes) {
    std::string value = GetParam().value;
    EXPECT_EQ(composeCommand(GetParam().key, value, kContext), GetParam().command);
}

TEST(EndsItsTextEarlyTest, IsACoderCommandWithAQuoteInItsText) {
    EXPECT_TRUE(endsItsTextEarly(R"(:STEREO:DIRECT "PS=A"B     ")"));
    EXPECT_TRUE(endsItsTextEarly(R"(:STEREO:DIRECT "PS=";*RST;"")"));
    EXPECT_FALSE(endsItsTextEarly(R"(:STEREO:DIRECT "PS=RADIO   ")"));
    EXPECT_FALSE(endsItsTextEarly("FREQ \"1\" MHz\"")) << "no text of the coder's";
    EXPECT_FALSE(endsItsTextEarly(""));
    EXPECT_FALSE(endsItsTextEarly(R"(:STEREO:DIRECT "PS=A""B    ")")) << "a doubled quote is one of the text";
    EXPECT_TRUE(endsItsTextEarly(R"(:STEREO:DIRECT "PS=A"""B   ")"));
}

std::string lettersOf(std::string key) {
    std::erase_if(key, [](unsigned char c) { return std::isalnum(c) == 0; });
    return key;
}

/// The key and the case's place in its group.
std::string caseName(const ::testing::TestParamInfo<CommandCase>& info) {
    return lettersOf(info.param.key) + "Case" + std::to_string(info.index);
}

std::string keyName(const ::testing::TestParamInfo<const char*>& info) {
    return lettersOf(info.param);
}

const std::vector<CommandCase> kProgramCases = {
    {"PS", "RADIO", R"(:STEREO:DIRECT "PS=RADIO   ")"},
    {"PS", "ABCDEFGHIJ", R"(:STEREO:DIRECT "PS=ABCDEFGH")"},
    {"PS", "", R"(:STEREO:DIRECT "PS=        ")"},
    {"PI", "D3C0", R"(:STEREO:DIRECT "PI=D3C0")"},
    {"PI", "d3c", R"(:STEREO:DIRECT "PI=d3c ")"},
    {"PI", "D3C0F", R"(:STEREO:DIRECT "PI=D3C0")"},
    {"PTY", "7", R"(:STEREO:DIRECT "PTY=07")"},
    {"PTY", "12", R"(:STEREO:DIRECT "PTY=12")"},
    {"PTY", "123", R"(:STEREO:DIRECT "PTY=23")"},
    {"PTY", "", R"(:STEREO:DIRECT "PTY=00")"},
    {"TP", "0", ":stereo:rds:traffic:program OFF"},
    {"TP", "1", ":stereo:rds:traffic:program ON"},
    {"TP", "2", ""},
    {"TA", "1", R"(:STEREO:DIRECT "TA=1")"},
    {"MS", "M", R"(:STEREO:DIRECT "MS=M")"},
    {"DI", "15", R"(:STEREO:DIRECT "DI=15")"},
    {"RT", "Hello, world", R"(:STEREO:DIRECT "RT=10,0,Hello, world")"},
    {"RTA", "Gr\xFC\xDF e", ":STEREO:DIRECT \"RT=5,1,Gr\xFC\xDF e\""},
    {"DEL_RT", "ignored", R"(:STEREO:DIRECT "RT=0,0,")"},
    {"GROUPSEQ", "0A,2A", R"(:STEREO:DIRECT "GS=0A,2A")"},
    {"GROUPSEQ_TN", "14A", R"(:STEREO:DIRECT "GS=14A")"},
    {"STORE", "3", R"(:STEREO:DIRECT "STORE=3")"},
    {"ODA", "8,CD46", R"(:STEREO:DIRECT "3A=8,CD46")"},
    {"TMC", "00123456789", R"(:STEREO:DIRECT "8A=00123456789")"},
    {"TEST_M", "0101", R"(:STEREO:DIRECT "BIN=0101")"},
    {"TEST_D", "1010", R"(:STEREO:DIRECT "BIN=1010")"},
};
const std::vector<CommandCase> kClockCases = {
    {"UHR", "off", R"(:STEREO:DIRECT "CT=off")"},
    {"UHR", "OFF", R"(:STEREO:DIRECT "CT=off")"},
    {"UHR", "Off", R"(:STEREO:DIRECT "CT=off")"},
    {"UHR", "AUS", R"(:STEREO:DIRECT "CT=off")"},
    {"UHR", "Aus", R"(:STEREO:DIRECT "CT=08:15:30,05.03.09")"},
    {"UHR", "aus", R"(:STEREO:DIRECT "CT=08:15:30,05.03.09")"},
    {"UHR", "off ", R"(:STEREO:DIRECT "CT=08:15:30,05.03.09")"},
    {"UHR", "", R"(:STEREO:DIRECT "CT=08:15:30,05.03.09")"},
    {"ZEIT", "ignored", R"(:STEREO:DIRECT "CT=23:59:58,05.03.09")"},
};
const std::vector<CommandCase> kAfAndEonCases = {
    {"AF1", "87.6,88.0", R"(:STEREO:DIRECT "AF=87.6,88.0")"},
    {"AF2", "87.6", R"(:STEREO:DIRECT "AF=87.6")"},
    {"AF3", "87.6", R"(:STEREO:DIRECT "AF=87.6")"},
    {"AF4", "87.6", R"(:STEREO:DIRECT "AF=87.6")"},
    {"AF5", "", R"(:STEREO:DIRECT "AF=")"},
    {"EON_PI", "e2f", R"(:STEREO:DIRECT "EON-PI=e2f ")"},
    {"EON_PI", "E2F01", R"(:STEREO:DIRECT "EON-PI=E2F0")"},
    {"EON_PS", "OTHER", R"(:STEREO:DIRECT "EON-PS=D3C0,OTHER   ")"},
    {"EON_PS", "ABCDEFGHIJKLMN", R"(:STEREO:DIRECT "EON-PS=D3C0,ABCDEFGH")"},
    {"EON_PTY", "7", R"(:STEREO:DIRECT "EON-PTY=D3C0,7")"},
    {"EON_TP", "1", R"(:STEREO:DIRECT "EON-TP=D3C0,1")"},
    {"EON_TA", "0", R"(:STEREO:DIRECT "EON-TA=D3C0,0")"},
    {"EON_AFA", "99.9", R"(:STEREO:DIRECT "EON-AFA=D3C0,99.9")"},
    {"EON_AFB1", "99.9", R"(:STEREO:DIRECT "EON-AFB=D3C0,99.9")"},
    {"EON_AFB2", "99.9", R"(:STEREO:DIRECT "EON-AFB=D3C0,99.9")"},
    {"EON_AFB3", "99.9", R"(:STEREO:DIRECT "EON-AFB=D3C0,99.9")"},
    {"EON_AFB4", "99.9", R"(:STEREO:DIRECT "EON-AFB=D3C0,99.9")"},
    {"EON_AFB5", "99.9", R"(:STEREO:DIRECT "EON-AFB=D3C0,99.9")"},
    {"EON_DEL", "E2F0", R"(:STEREO:DIRECT "EON-DEL=E2F0")"},
};
const std::vector<CommandCase> kStereoCases = {
    {"RDS", "0", ":stereo:rds:state OFF"},
    {"RDS", "1", ":stereo:rds:state ON"},
    {"RDS", "ON", ""},
    {"RDS_HUB", "200", ":STEREO:RDS:DEVIATION 2000HZ"},
    {"RDS_PHASE", "90", R"(:STEREO:DIRECT "RDS-PH=90")"},
    {"MPX_HUB", "67.5", ":STEREO:DEVIATION 675HZ"},
    {"MPX_HUB", "abc", ":STEREO:DEVIATION 0HZ"},
    {"MPX_HUB", "", ":STEREO:DEVIATION 0HZ"},
    {"MPX_HUB", "  4000 x", ":STEREO:DEVIATION 40000HZ"},
    {"MPX_HUB", "0.25", ":STEREO:DEVIATION 2.5HZ"},
    {"MPX_HUB", "-3", ":STEREO:DEVIATION -30HZ"},
    {"MPX_HUB", "00350", ":STEREO:DEVIATION 3500HZ"},
    {"MPX_HUB", "67,5", ":STEREO:DEVIATION 670HZ"},
    {"MPX_SOURCE", "0", "STEREO:STAT OFF"},
    {"MPX_SOURCE", "1", "STEREO:STAT ON;:stereo:source LREXT"},
    {"MPX_SOURCE", "2", "STEREO:STAT ON;:stereo:source SPEXT"},
    {"MPX_SOURCE", "3", "STEREO:STAT ON;:stereo:source LFGEN"},
    {"MPX_SOURCE", "4", ""},
    {"MPX_IMPEDANZ", "1", ":STEREO:EXTERNAL:IMP 600"},
    {"MPX_IMPEDANZ", "2", ":STEREO:EXTERNAL:IMP 100000"},
    {"MPX_IMPEDANZ", "0", ""},
    {"STEREO_MODE", "0", ""},
    {"STEREO_MODE", "1", ":stereo:audio:mode LEFT"},
    {"STEREO_MODE", "2", ":stereo:audio:mode RIGHT"},
    {"STEREO_MODE", "3", ":stereo:audio:mode REL"},
    {"STEREO_MODE", "4", ":stereo:audio:mode REML"},
    {"STEREO_MODE", "5", ":stereo:audio:mode RNEL"},
    {"PREEMPHASIS", "0", ":stereo:audio:preemphasis:state OFF"},
    {"PREEMPHASIS", "1", ":stereo:audio:preemphasis:state ON;:stereo:audio:preemphasis 50us"},
    {"PREEMPHASIS", "2", ":stereo:audio:preemphasis:state ON;:stereo:audio:preemphasis 75us"},
    {"PREEMPHASIS", "3", ""},
    {"PILOT", "0", ":stereo:pilot:state OFF"},
    {"PILOT", "1", ":stereo:pilot:state ON"},
    {"PILOT", "", ""},
    {"PILOT_HUB", "675", ":STEREO:PILOT:DEVIATION 6750HZ"},
    {"PILOT_PHASE", "0.5 x", ":STEREO:PILOT:PHASE 0.5 xDEG"},
    {"ARI", "0", ":stereo:ari:state OFF"},
    {"ARI", "1", ":stereo:ari:state ON"},
    {"ARI", "1 ", ""},
    {"ARI-HUB", "350", ":stereo:ari:deviation 3500HZ"},
    {"ARI-ID", "0", ":stereo:ari:type:state OFF"},
    {"ARI-ID", "1", ":stereo:ari:type:state ON;:stereo:ari:type DK"},
    {"ARI-ID", "2", ":stereo:ari:type:state ON;:stereo:ari:type BK"},
    {"ARI-ID", "3", ":stereo:ari:type:state ON;:stereo:ari:type BKDK"},
    {"ARI-ID", "4", ""},
    {"ARI-BK", "A", ":stereo:ari:bk A"},
    {"STEREO_EIN", "ignored", "STEREO:STAT ON"},
    {"STEREO_AUS", "ignored", "STEREO:STAT OFF"},
};
const std::vector<CommandCase> kGeneratorCases = {
    {"FM_EIN", "ignored", "FM:STAT ON"},
    {"FM_AUS", "ignored", "FM:STAT OFF"},
    {"AM_AUS", "ignored", "AM:STAT OFF"},
    {"HF:PEGEL:STATE", "ON", ":OUTPUT:STAT ON"},
    {"HF-Frequenz", "87.6", "FREQ 87.6MHZ"},
    {"HF-Pegel", "-4", ":POW -4DBUV"},
    {"NF-Frequenz", "1", ":STEREO:AUDIO:FREQ 1KHZ"},
};

INSTANTIATE_TEST_SUITE_P(Program, ComposeCommand, ::testing::ValuesIn(kProgramCases), caseName);
INSTANTIATE_TEST_SUITE_P(Clock, ComposeCommand, ::testing::ValuesIn(kClockCases), caseName);
INSTANTIATE_TEST_SUITE_P(AfAndEon, ComposeCommand, ::testing::ValuesIn(kAfAndEonCases), caseName);
INSTANTIATE_TEST_SUITE_P(Stereo, ComposeCommand, ::testing::ValuesIn(kStereoCases), caseName);
INSTANTIATE_TEST_SUITE_P(Generator, ComposeCommand, ::testing::ValuesIn(kGeneratorCases), caseName);

TEST(ComposeCommandTest, KeysWithoutACommandGiveNothing) {
    // "ARI_HUB", "ARI_ID" and "AR_BK" are what sending the data set calls the ARI keys: nothing comes of them.
    for (const char* key :
         {"NFShape Sinus", "DS", "", "ps", "PS ", "RTB", "AF6", "EON_AFB", "ARI_HUB", "ARI_ID", "AR_BK", "ARI_BK"}) {
        std::string value = "1";
        EXPECT_EQ(composeCommand(key, value, kContext), std::nullopt) << key;
        EXPECT_EQ(value, "1");
    }
}

TEST(ComposeCommandTest, OnlyThePiRewritesItsValue) {
    for (const auto* group : {&kProgramCases, &kClockCases, &kAfAndEonCases, &kStereoCases, &kGeneratorCases}) {
        for (const CommandCase& sent : *group) {
            std::string value = sent.value;
            ASSERT_TRUE(composeCommand(sent.key, value, kContext));
            if (sent.key != "PI"s) {
                EXPECT_EQ(value, sent.value) << sent.key;
            }
        }
    }
    std::string pi = "d3c";
    ASSERT_TRUE(composeCommand("PI", pi, kContext));
    EXPECT_EQ(pi, "d3c ");
    std::string longPi = "D3C0F";
    ASSERT_TRUE(composeCommand("PI", longPi, kContext));
    EXPECT_EQ(longPi, "D3C0");
}

class DeviationKey : public ::testing::TestWithParam<const char*> {};

TEST_P(DeviationKey, TooLargeANumberOverflows) {
    for (std::string value : {"1e308", "-1e308", "1e999"}) {
        EXPECT_THROW((void)composeCommand(GetParam(), value, kContext), std::overflow_error) << value;
    }
}

INSTANTIATE_TEST_SUITE_P(All, DeviationKey, ::testing::Values("MPX_HUB", "PILOT_HUB", "RDS_HUB", "ARI-HUB"), keyName);

class ParamSenderTest : public ::testing::Test, protected test::LinkFixture {
protected:
    ParamSenderTest() {
        state.InstrumentOnline = true;
        state.LogEnabled = true;
        state.shownClock = "08:15:30";
        clock.set(100);  // pauses are measured in single precision: exact to the millisecond early in the day only
    }
    [[nodiscard]] std::string log() const { return folder.read(kCommandLog); }
};

TEST_F(ParamSenderTest, SendsAndLogsOneCommand) {
    params.SendParam("PS", "RADIO");
    EXPECT_EQ(sent(), Lines{R"(:STEREO:DIRECT "PS=RADIO   ")"});
    EXPECT_EQ(log(), "             PS= \":STEREO:DIRECT \"PS=RADIO   \"\"\r\n");
}

TEST_F(ParamSenderTest, LogsThenPausesThenWrites) {
    Lines events;
    const test::TrafficListener listener(instrument, [&](const Traffic& traffic) {
        const bool logged = traffic.kind == Traffic::Kind::Logged;
        events.push_back((logged ? "log after " : "write after ") + std::to_string(std::lround(clock.sleptMs())));
        EXPECT_FALSE(log().empty());
    });
    params.SendParam("TA", "1");
    EXPECT_EQ(events, (Lines{"log after 0", "write after 50"}));
}

TEST_F(ParamSenderTest, EveryCommandHasItsOwnPause) {
    for (int i = 0; i < 10; ++i) params.SendParam("TA", "1");
    EXPECT_NEAR(clock.sleptMs(), 500, 1);
    EXPECT_EQ(visa.written.size(), 10U);
}

TEST_F(ParamSenderTest, WithoutASessionItLogsButNeitherPausesNorSends) {
    state.InstrumentOnline = false;
    params.SendParam("TP", "1");
    EXPECT_EQ(sent(), Lines{});
    EXPECT_TRUE(clock.sleeps.empty());
    EXPECT_EQ(log(), "             TP= \":stereo:rds:traffic:program ON\"\r\n");
}

TEST_F(ParamSenderTest, SomebodyMayHearEveryCommandWithASessionOrWithout) {
    Lines heard;
    params.onComposed([&heard](const std::string& command) { heard.push_back(command); });
    params.SendParam("PS", "RADIO");
    state.InstrumentOnline = true;
    params.SendParam("TP", "1");
    visa.writeStatus = visa::kConnectionLost;
    params.sendCommand("STORE", test::direct("STORE=1"));
    EXPECT_EQ(heard,
              (Lines{R"(:STEREO:DIRECT "PS=RADIO   ")", ":stereo:rds:traffic:program ON", test::direct("STORE=1")}));
    params.SendParam("NO SUCH KEY", "1");
    params.onComposed(nullptr);
    params.SendParam("TP", "0");
    EXPECT_EQ(heard.size(), 3U);
}

TEST_F(ParamSenderTest, AValueThatIsNoChoiceLogsAndSendsAnEmptyCommand) {
    // The row exists, so the road is taken to its end: the coder sees an empty write, which it ignores.
    params.SendParam("TP", "2");
    params.SendParam("STEREO_MODE", "0");
    EXPECT_EQ(sent(), (Lines{"", ""}));
    EXPECT_EQ(log(), "             TP= \r\n    STEREO_MODE= \r\n");
    EXPECT_NEAR(clock.sleptMs(), 100, 1);
}

TEST_F(ParamSenderTest, UnknownKeysAndTheSineShapeDoNothingAtAll) {
    for (const char* key : {"NFShape Sinus", "NOKEY", "ps", "ARI_HUB", ""}) params.SendParam(key, "1");
    EXPECT_EQ(sent(), Lines{});
    EXPECT_TRUE(clock.sleeps.empty());
    EXPECT_EQ(log(), "");
}

TEST_F(ParamSenderTest, ThePiComesBackInItsFourCharacterForm) {
    std::string pi = "d3c";
    params.SendParam("PI", pi);
    EXPECT_EQ(sent(), Lines{R"(:STEREO:DIRECT "PI=d3c ")"});
    EXPECT_EQ(pi, "d3c ");
}

TEST_F(ParamSenderTest, OtherValuesStayAsTheCallerHasThem) {
    std::string ps = "ABCDEFGHIJ";
    params.SendParam("PS", ps);
    EXPECT_EQ(ps, "ABCDEFGHIJ");
    std::string eonPi = "e2f";
    params.SendParam("EON_PI", eonPi);
    EXPECT_EQ(eonPi, "e2f");
}

TEST_F(ParamSenderTest, TheExtrasAndTheModeChangeNothing) {
    const std::string key = "TA";
    std::string value = "1";
    std::int16_t mode = 7;
    params.SendParam(key, value, "extra", "more", mode);
    EXPECT_EQ(sent(), Lines{R"(:STEREO:DIRECT "TA=1")"});
    EXPECT_EQ(key, "TA");
    EXPECT_EQ(value, "1");
    EXPECT_EQ(mode, 7);
}

TEST_F(ParamSenderTest, EonCommandsAreLedByTheCurrentIdentifierAsItStands) {
    params.SendParam("EON_TP", "1");
    state.eonIdentifier = "e2f";
    params.SendParam("EON_TP", "1");
    EXPECT_EQ(sent(), (Lines{R"(:STEREO:DIRECT "EON-TP=,1")", R"(:STEREO:DIRECT "EON-TP=e2f,1")"}));
}

TEST_F(ParamSenderTest, ShownClockAndPcClockGoOutWithTodaysDate) {
    clock.set(7 * 3600 + 5 * 60 + 9.99);
    params.SendParam("UHR", "EIN");
    clock.set(7 * 3600 + 5 * 60 + 9.99);
    params.SendParam("ZEIT", "");
    EXPECT_EQ(sent(), (Lines{R"(:STEREO:DIRECT "CT=08:15:30,05.03.09")", R"(:STEREO:DIRECT "CT=07:05:09,05.03.09")"}));
}

TEST_F(ParamSenderTest, TimeAndDateAlwaysHaveTwoDigitsEach) {
    state.InstrumentOnline = false;  // the command in the log is enough: no pause runs across midnight
    clock.set(0);
    clock.setDate({2000, 1, 1});
    params.SendParam("ZEIT", "");
    clock.set(86399.999);
    clock.setDate({1999, 12, 31});
    params.SendParam("ZEIT", "");
    EXPECT_EQ(log(),
              "           ZEIT= \":STEREO:DIRECT \"CT=00:00:00,01.01.00\"\"\r\n"
              "           ZEIT= \":STEREO:DIRECT \"CT=23:59:59,31.12.99\"\"\r\n");
}

TEST_F(ParamSenderTest, TheDataSetKeyEndsTheProgramAtOnce) {
    // Kept for data sets that hold the key, although no control uses it.
    std::string value = "1";
    params.SendParam("DS", value, "3", "", state.sendMode);
    EXPECT_EQ(ended, 1);
    EXPECT_EQ(sent(), Lines{});
    EXPECT_TRUE(clock.sleeps.empty());
    EXPECT_EQ(log(), "");
}

TEST_F(ParamSenderTest, NoOtherKeyEndsTheProgram) {
    params.SendParam("ds", "1");
    params.SendParam("PS", "DS");
    EXPECT_EQ(ended, 0);
}

TEST_F(ParamSenderTest, AnOverflowReachesTheCallerAndNothingIsLoggedOrSent) {
    EXPECT_THROW(params.SendParam("MPX_HUB", "1e308"), std::overflow_error);
    EXPECT_EQ(sent(), Lines{});
    EXPECT_EQ(log(), "");
}

TEST_F(ParamSenderTest, AFailedWriteIsReportedOnceAndNotTriedAgain) {
    visa.writeStatus = visa::kTimeout;
    params.SendParam("TA", "1");
    EXPECT_EQ(failures, Lines{"Fehler: -1073807339"});
    EXPECT_EQ(visa.written.size(), 1U);
}

TEST_F(ParamSenderTest, LoggingOffChangesNothingOnTheWire) {
    state.LogEnabled = false;
    params.SendParam("TA", "1");
    EXPECT_EQ(sent(), Lines{R"(:STEREO:DIRECT "TA=1")"});
    EXPECT_EQ(log(), "");
}

}  // namespace
}  // namespace kdx
