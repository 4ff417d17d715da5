#include <QGroupBox>
#include <QMouseEvent>

#include "rdspagetest.h"

namespace kdx::test {
namespace {

TEST_F(RdsPageTest, SendingThePsCutsItToEightCharacters) {
    type("PS_T", "ABCDEFGHIJ");
    click("PS_Taste");
    EXPECT_EQ(sent(), Lines{direct("PS=ABCDEFGH")});
    EXPECT_EQ(stored("PS"), "ABCDEFGH");
    EXPECT_EQ(status(StatusSlot::Ps), "ABCDEFGH");
    EXPECT_EQ(programme.ps, "ABCDEFGH");
}

TEST_F(RdsPageTest, AShortPsIsPaddedForTheCoderOnly) {
    type("PS_T", "RADIO");
    click("PS_Taste");
    EXPECT_EQ(sent(), Lines{direct("PS=RADIO   ")});
    EXPECT_EQ(stored("PS"), "RADIO");
    EXPECT_EQ(status(StatusSlot::Ps), "RADIO");
}

TEST_F(RdsPageTest, UmlautsTravelAsOneByteEach) {
    type("PS_T", "M\xC3\xBCnchen \xE2\x82\xAC");
    click("PS_Taste");
    EXPECT_EQ(sent(), Lines{direct("PS=M\xFCnchen ")});
    EXPECT_EQ(folder.read("Datenset1.INI"), "[RDS]\r\nPS=M\xFCnchen \r\n");
}

TEST_F(RdsPageTest, TypingAPiSendsNothing) {
    type("PI_T", "d3c");
    EXPECT_EQ(sent(), Lines{});
    EXPECT_EQ(stored("PI"), "");
    EXPECT_EQ(programme.pi, "d3c");
}

TEST_F(RdsPageTest, WhatIsTypedGoesOutWithTheDataSetBeforeItIsSent) {
    type("PI_T", "D3C2");
    type("RT_Text1", "News");
    type("PS_T", "RADIO");
    EXPECT_EQ(programme.pi, "D3C2");
    EXPECT_EQ(programme.radiotext, "News");
    EXPECT_EQ(programme.ps, "");  // only its button takes the name over
    click("RT_clear1");
    EXPECT_EQ(programme.radiotext, "");
}

TEST_F(RdsPageTest, ThePiIsStoredAsTypedAndSentWithFourCharacters) {
    type("PI_T", "d3c");
    click("Command3");
    EXPECT_EQ(sent(), Lines{direct("PI=d3c ")});
    EXPECT_EQ(folder.read("Datenset1.INI"), "[RDS]\r\nPI=d3c\r\n");
    EXPECT_EQ(status(StatusSlot::Pi), "d3c");
    EXPECT_EQ(text("PI_T"), "d3c");
    EXPECT_EQ(programme.pi, "d3c ");  // the form that was sent
    type("PI_T", "D3C2F");
    click("Command3");
    EXPECT_EQ(sent(), Lines{direct("PI=D3C2")});
    EXPECT_EQ(stored("PI"), "D3C2F");
    EXPECT_EQ(programme.pi, "D3C2");
}

TEST_F(RdsPageTest, TheReturnKeySendsTheEntryItIsPressedIn) {
    type("PS_T", "RADIO");
    press("PS_T", Qt::Key_Return);
    type("PI_T", "D3C2");
    press("PI_T", Qt::Key_Return);
    type("RT_Text1", "News");
    press("RT_Text1", Qt::Key_Return);
    EXPECT_EQ(sent(), (Lines{direct("PS=RADIO   "), direct("PI=D3C2"), direct("RT=10,0,News")}));
}

TEST_F(RdsPageTest, TheProgrammeTypeGoesToDataSetOneWhateverSetIsCurrent) {
    state.CurrentDataSet = "3";
    select("PTY_Combo1", 12);
    EXPECT_EQ(sent(), Lines{direct("PTY=12")});
    EXPECT_EQ(stored("PTY"), "12");
    EXPECT_EQ(programme.pty, "12");
    select("PTY_Combo1", 0);
    EXPECT_EQ(sent(), Lines{direct("PTY=00")});
    EXPECT_EQ(stored("PTY"), "0");
    EXPECT_EQ(profile("Datenset3.INI", "RDS", "PTY"), "");
    EXPECT_EQ(status(StatusSlot::Pty), text("PTY_Combo1"));
}

TEST_F(RdsPageTest, EverythingElseGoesToTheCurrentDataSet) {
    state.CurrentDataSet = "3";
    type("PS_T", "RADIO");
    click("PS_Taste");
    type("PI_T", "D3C2");
    click("Command3");
    click("MS_opt_0");
    click("DI_Opt_3");
    type("RT_Text1", "News");
    click("RT_Taste1");
    EXPECT_EQ(folder.read("Datenset3.INI"), "[RDS]\r\nPS=RADIO\r\nPI=D3C2\r\nMS=M\r\nDI=3\r\nRTA=News\r\n");
    EXPECT_FALSE(std::filesystem::exists(folder.data() / "Datenset1.INI"));
}

TEST_F(RdsPageTest, TickingTheTrafficProgrammeFreesTheAnnouncements) {
    EXPECT_FALSE(enabled("TA_Check"));
    EXPECT_FALSE(enabled("TA_Option_1"));
    click("Check1");
    EXPECT_EQ(sent(), Lines{":stereo:rds:traffic:program ON"});
    EXPECT_EQ(status(StatusSlot::Tp), "ein");
    EXPECT_EQ(programme.trafficProgramme, "1");
    EXPECT_TRUE(enabled("TA_Option_0"));
    EXPECT_TRUE(enabled("TA_Option_1"));
    EXPECT_TRUE(enabled("TA_Check"));
    EXPECT_FALSE(std::filesystem::exists(folder.data() / "Datenset1.INI"));
}

TEST_F(RdsPageTest, UntickingTheTrafficProgrammeLeavesManualUsable) {
    click("Check1");
    click("Check1");
    EXPECT_EQ(sent(), (Lines{":stereo:rds:traffic:program ON", ":stereo:rds:traffic:program OFF"}));
    EXPECT_EQ(status(StatusSlot::Tp), "aus");
    EXPECT_EQ(programme.trafficProgramme, "0");
    EXPECT_TRUE(enabled("TA_Option_0"));
    EXPECT_FALSE(enabled("TA_Option_1"));
    EXPECT_FALSE(enabled("TA_Check"));
}

TEST_F(RdsPageTest, MusicAndSpeech) {
    click("MS_opt_0");
    EXPECT_EQ(status(StatusSlot::MusicSpeech), "Musik");
    EXPECT_EQ(stored("MS"), "M");
    EXPECT_EQ(programme.musicSpeech, "M");
    click("MS_opt_1");
    EXPECT_EQ(status(StatusSlot::MusicSpeech), "Sprache");
    EXPECT_EQ(stored("MS"), "S");
    EXPECT_EQ(programme.musicSpeech, "S");
    EXPECT_EQ(sent(), (Lines{direct("MS=M"), direct("MS=S")}));
}

TEST_F(RdsPageTest, DecoderInformationIsTheOptionsNumber) {
    for (int i = 0; i < 16; ++i) {
        const std::string number = std::to_string(i);
        click(("DI_Opt_" + number).c_str());
        EXPECT_EQ(sent(), Lines{direct("DI=" + number)});
        EXPECT_EQ(stored("DI"), number);
        EXPECT_EQ(programme.decoderInfo, number);
    }
}

TEST_F(RdsPageTest, DecoderInformationIsCaptionedAsDesigned) {
    const Lines design = {"Mono",
                          "Stereo",
                          "NN",
                          "St Kunstkopf",
                          "Mono compr.",
                          "Stereo compr.",
                          "Stereo comp. Kunstkopf",
                          "Stereo comp. Kunstkopf",
                          "8",
                          "9",
                          "10",
                          "11",
                          "12",
                          "13",
                          "14",
                          "15"};
    for (std::size_t i = 0; i < design.size(); ++i) {
        EXPECT_EQ(text(("DI_Opt_" + std::to_string(i)).c_str()), design[i]);
    }
    EXPECT_EQ(find<QGroupBox>("DI_Frame")->title(), QStringLiteral("Decoder Info"));
}

TEST_F(RdsPageTest, RadiotextIsStoredAsTextAAndSentAsTyped) {
    type("RT_Text1", " News \"1\" ");
    click("RT_Taste1");
    EXPECT_EQ(sent(), Lines{direct("RT=10,0, News \"1\" ")});
    EXPECT_EQ(folder.read("Datenset1.INI"), "[RDS]\r\nRTA= News \"1\" \r\n");
    EXPECT_EQ(stored("RT"), "");
}

TEST_F(RdsPageTest, ClearingTheRadiotextSendsThreeBlanksAndStoresNothing) {
    type("RT_Text1", "News");
    click("RT_Taste1");
    sent();
    click("RT_clear1");
    EXPECT_EQ(sent(), Lines{direct("RT=10,0,   ")});
    EXPECT_EQ(text("RT_Text1"), "");
    EXPECT_EQ(stored("RTA"), "News");
}

TEST_F(RdsPageTest, TheClockIsSilentUntilItIsSwitchedOn) {
    EXPECT_EQ(find<QTimer>("Timer1")->interval(), 999);
    EXPECT_TRUE(tick("Timer1"));
    EXPECT_EQ(sent(), Lines{});
    EXPECT_EQ(text("Uhr_Zeit"), "aus");
}

TEST_F(RdsPageTest, TheClockIsSentEveryTwentySecondsOnceSwitchedOn) {
    click("Zeit_Taste");
    EXPECT_TRUE(checked("Zeit_Taste"));
    EXPECT_EQ(find<QTimer>("Timer1")->interval(), 20000);
    EXPECT_EQ(text("Uhr_Zeit"), "aus");
    EXPECT_EQ(sent(), Lines{});
    clock.set(9 * 3600 + 5 * 60 + 7.9);
    tick("Timer1");
    EXPECT_EQ(text("Uhr_Zeit"), "09:05:07");
    EXPECT_EQ(state.shownClock, "09:05:07");
    EXPECT_EQ(sent(), Lines{direct("CT=09:05:07,05.03.09")});
    clock.set(23 * 3600 + 59 * 60 + 59);
    tick("Timer1");
    EXPECT_EQ(sent(), Lines{direct("CT=23:59:59,05.03.09")});
}

TEST_F(RdsPageTest, SwitchingTheClockOffLeavesTheCodersClockRunning) {
    click("Zeit_Taste");
    tick("Timer1");
    sent();
    click("Zeit_Taste");
    EXPECT_FALSE(checked("Zeit_Taste"));
    EXPECT_EQ(find<QTimer>("Timer1")->interval(), 20000);
    EXPECT_EQ(text("Uhr_Zeit"), "aus");
    tick("Timer1");
    EXPECT_EQ(sent(), Lines{});
    EXPECT_EQ(text("Uhr_Zeit"), "aus");
    EXPECT_EQ(state.shownClock, "aus");
}

TEST_F(RdsPageTest, ADoubleClickOnTheTimeAsksAndForgetsTheAnswer) {
    clock.set(12 * 3600 + 34 * 60 + 56);
    dialogs.inputs = {QStringLiteral("01:02:03")};
    auto* label = find("Uhr_Zeit");
    QMouseEvent event(QEvent::MouseButtonDblClick, QPointF(2, 2), label->mapToGlobal(QPointF(2, 2)), Qt::LeftButton,
                      Qt::LeftButton, Qt::NoModifier);
    QApplication::sendEvent(label, &event);
    ASSERT_EQ(dialogs.shown.size(), 1U);
    EXPECT_EQ(dialogs.shown[0].text, QStringLiteral("Uhrzeit: "));
    EXPECT_EQ(dialogs.shown[0].title, QStringLiteral("Zeit eingabe"));
    EXPECT_EQ(dialogs.shown[0].preset, QStringLiteral("12:34:56"));
    EXPECT_EQ(sent(), Lines{});
    EXPECT_EQ(text("Uhr_Zeit"), "aus");
}

TEST_F(RdsPageTest, TheTimeIsAskedForInTheWindowsLanguage) {
    useLanguage("english");
    page.label();
    dialogs.inputs = {QString()};
    press("Uhr_Zeit", Qt::Key_Space);
    EXPECT_EQ(dialogs.shown[0].text, QStringLiteral("Time: "));
    EXPECT_EQ(dialogs.shown[0].title, QStringLiteral("Time entry"));
}

TEST_F(RdsPageTest, WithoutASessionEverythingIsStoredAndShownButNothingSent) {
    state.InstrumentOnline = false;
    type("PS_T", "RADIO");
    click("PS_Taste");
    click("DI_Opt_1");
    EXPECT_EQ(sent(), Lines{});
    EXPECT_EQ(stored("PS"), "RADIO");
    EXPECT_EQ(stored("DI"), "1");
    EXPECT_EQ(status(StatusSlot::Ps), "RADIO");
}

TEST_F(RdsPageTest, AFailedCommandShowsOneBoxAndIsStoredNevertheless) {
    visa.writeStatus = visa::kTimeout;
    dialogs.expectedMessages = 1;
    type("PS_T", "RADIO");
    click("PS_Taste");
    EXPECT_EQ(dialogs.shown[0].text, QStringLiteral("Fehler: -1073807339"));
    EXPECT_EQ(stored("PS"), "RADIO");
}

}  // namespace
}  // namespace kdx::test
