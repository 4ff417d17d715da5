#include "onairviewtest.h"

#include <gmock/gmock.h>

#include <chrono>

namespace kdx::test {
namespace {

using namespace std::chrono_literals;
using ::testing::HasSubstr;
using ::testing::Not;

TEST_F(OnAirViewTest, ARowIsMarkedWhereTheRadioShowsSomethingElse) {
    open();
    type("PS_T", "KURZ");
    click("PS_Taste");
    listen();
    EXPECT_EQ(mark("Air_PS"), "Mit Leerzeichen aufgefüllt; eingegeben ist \"KURZ\"");
    type("PS_T", "VIEL ZU LANG");
    click("PS_Taste");
    listen();
    EXPECT_EQ(text("Air_PS"), "VIEL ZU ");
    EXPECT_EQ(mark("Air_PS"), "Für die Anzeige gekürzt; eingegeben ist \"VIEL ZU LANG\"");
    type("PS_T",
         "A\xC2\xA6"
         "BCDEFG");
    click("PS_Taste");
    listen();
    EXPECT_EQ(text("Air_PS"), "A BCDEFG");
    EXPECT_EQ(mark("Air_PS"), "RDS kennt das Zeichen \"\xC2\xA6\" nicht: das Radio zeigt ein Leerzeichen");
    type("PS_T", "RADIO 12");
    listen();
    EXPECT_EQ(mark("Air_PS"), "Eingegeben ist \"RADIO 12\"") << "not sent yet";
    click("PS_Taste");
    listen();
    EXPECT_EQ(mark("Air_PS"), "");
}

TEST_F(OnAirViewTest, ARefusedPiIsMarked) {
    open();
    type("PI_T", "XYZ1");
    click("Command3");
    listen();
    EXPECT_EQ(text("Air_PI"), "D7A1");
    EXPECT_EQ(mark("Air_PI"), "Der Coder nimmt \"XYZ1\" nicht an");
    type("PI_T", "D7A1");
    click("Command3");
    listen();
    EXPECT_EQ(mark("Air_PI"), "");
}

TEST_F(OnAirViewTest, OnlyWhatWasRefusedIsSaidToBeRefused) {
    open();
    type("PI_T", "XYZ1");
    click("Command3");
    type("PI_T", "D3C1");
    listen();
    EXPECT_EQ(mark("Air_PI"), "Eingegeben ist \"D3C1\"") << "that was never sent";
}

TEST_F(OnAirViewTest, EveryChoiceThatWasNotSentIsMarked) {
    open();
    state.InstrumentOnline = false;
    Programme& entered = session->station.programme;
    entered.pty = "7";
    entered.trafficProgramme = text("Air_TP") == "ein" ? "0" : "1";
    entered.announcement = "1";
    entered.musicSpeech = "S";
    entered.decoderInfo = "15";
    listen();
    for (const char* row : {"Air_PTY", "Air_TP", "Air_TA", "Air_MS", "Air_DI"}) EXPECT_NE(mark(row), "") << row;
    EXPECT_EQ(mark("Air_DI"), "Eingegeben ist \"15\"");
}

TEST_F(OnAirViewTest, ARadiotextThatNoGroupCarriesWholeIsMarked) {
    open();
    listen();
    EXPECT_EQ(mark("Air_RT"), "");
    session->params.SendParam("GROUPSEQ", "0A,2B");
    listen();
    EXPECT_THAT(mark("Air_RT"), HasSubstr("Für die Anzeige gekürzt; eingegeben ist"));
    session->params.SendParam("GROUPSEQ", "0A");
    listen();
    EXPECT_THAT(mark("Air_RT"), HasSubstr("Eingegeben ist"));
}

TEST_F(OnAirViewTest, AnotherNetworkIsMarkedWhereItDiffers) {
    open();
    listen(30s);
    state.corrections.eonType = true;
    select("EON_PTY_Combo", 2);
    select("EON_PTY_Combo", 1);
    listen(30s);
    EXPECT_EQ(remark("D7A2"), "");
    session->station.otherNetwork.tp = "0";
    listen();
    EXPECT_EQ(remark("D7A2"), "Eingegeben ist TP 0");
    session->station.otherNetwork.tp = "1";
    session->station.otherNetwork.ta = "1";
    listen();
    EXPECT_EQ(remark("D7A2"), "Eingegeben ist TA 1");
    session->station.otherNetwork.ps = "ANDERS";
    listen();
    EXPECT_EQ(remark("D7A2"), "Eingegeben ist ANDERS");
}

TEST_F(OnAirViewTest, AStereoModeThatThePanelNamesOtherwiseIsMarked) {
    open();
    click("Stereo_Opt_1");
    listen();
    EXPECT_EQ(text("Air_Stereo"), "links");
    EXPECT_EQ(mark("Air_Stereo"), "Im Fenster heißt diese Einstellung rechts. Die Berichtigung Stereo_Mode behebt das");
    state.corrections.stereoMode = true;
    click("Stereo_Opt_2");
    click("Stereo_Opt_1");
    listen();
    EXPECT_EQ(text("Air_Stereo"), "rechts");
    EXPECT_EQ(mark("Air_Stereo"), "");
}

TEST_F(OnAirViewTest, AQuoteThatTheCoderRefusesIsMarkedWithItsCorrection) {
    open();
    type("PS_T", "A\"B");
    click("PS_Taste");
    listen();
    EXPECT_EQ(mark("Air_PS"), "Der Coder nimmt \"A\"B\" nicht an. Die Berichtigung Anfuehrung behebt das");
    state.corrections.quotes = true;
    listen();
    EXPECT_EQ(mark("Air_PS"), "Der Coder nimmt \"A\"B\" nicht an") << "not sent again yet";
    click("PS_Taste");
    listen();
    EXPECT_EQ(text("Air_PS"), "A\"B     ");
}

TEST_F(OnAirViewTest, AnotherNetworksProgrammeTypeIsMarkedWithItsCorrection) {
    open();
    listen(30s);
    EXPECT_EQ(remark("D7A2"), "Eingegeben ist Nachrichten. Die Berichtigung EON_PTY behebt das")
        << "stored, never sent";
    select("EON_PTY_Combo", 3);
    listen(30s);
    EXPECT_EQ(remark("D7A2"), "Eingegeben ist Information. Die Berichtigung EON_PTY behebt das");
    state.corrections.eonType = true;
    select("EON_PTY_Combo", 4);
    listen(30s);
    EXPECT_EQ(remark("D7A2"), "");
}

TEST_F(OnAirViewTest, AnotherNetworksQuoteIsMarkedWithItsCorrection) {
    open();
    listen(30s);
    type("EON_PS_Text", "A\"B");
    click("EON_PS_Taste");
    listen(30s);
    EXPECT_EQ(remark("D7A2"), "Der Coder nimmt A\"B nicht an. Die Berichtigung Anfuehrung behebt das");
    state.corrections.quotes = true;
    listen();
    EXPECT_EQ(remark("D7A2"), "Der Coder nimmt A\"B nicht an") << "not sent again yet";
    click("EON_PS_Taste");
    listen(30s);
    EXPECT_EQ(remark("D7A2").find("Der Coder"), std::string::npos) << remark("D7A2");
}

TEST_F(OnAirViewTest, ATrafficMessageRefusedForAnUnchosenFieldIsToldWithItsCorrection) {
    open();
    select("TMC_Event_Combo", 0);
    click("TMC_Gr8_apply");
    click("TMC_Senden_Taste");
    ASSERT_TRUE(tick("TMC_Sende_Timer"));
    listen();
    EXPECT_THAT(cells("Air_Budget"), HasSubstr("Nicht angenommen: "));
    EXPECT_THAT(cells("Air_Budget"), HasSubstr(". Die Berichtigung TMC_Felder behebt das|"));
    state.corrections.trafficFields = true;
    session->params.SendParam("RT", "X");  // what is told is told anew after a command
    listen();
    EXPECT_THAT(cells("Air_Budget"), HasSubstr("Nicht angenommen: "));
    EXPECT_THAT(cells("Air_Budget"), Not(HasSubstr("TMC_Felder")));
}

TEST_F(OnAirViewTest, AnotherRefusedCommandIsToldWithoutACorrection) {
    open();
    type("PI_T", "XYZ1");
    click("Command3");
    listen();
    EXPECT_THAT(cells("Air_Budget"), HasSubstr("Nicht angenommen: "));
    EXPECT_THAT(cells("Air_Budget"), Not(HasSubstr("Berichtigung")));
}

}  // namespace
}  // namespace kdx::test
