#include "rds/rdspage.h"

#include <QGroupBox>
#include <QMouseEvent>

#include "support/pagetest.h"

namespace kdx::test {
namespace {

std::string coder(const std::string& command) {
    return ":STEREO:DIRECT \"" + command + "\"";
}

class RdsPageTest : public PageTest {
protected:
    RdsPageTest() {
        clockText = [this] { return page.clockText(); };
        page.label();
    }
    QWidget& root() override { return page; }
    std::string stored(const std::string& key) const { return profile("Datenset1.INI", "RDS", key); }

    RdsPage page{context, nullptr};
};

TEST_F(RdsPageTest, SendingThePsCutsItToEightCharacters) {
    type("PS_T", "ABCDEFGHIJ");
    click("PS_Taste");
    EXPECT_EQ(sent(), Lines{coder("PS=ABCDEFGH")});
    EXPECT_EQ(stored("PS"), "ABCDEFGH");
    EXPECT_EQ(status(StatusSlot::Ps), "ABCDEFGH");
    EXPECT_EQ(state.currentPs, "ABCDEFGH");
}

TEST_F(RdsPageTest, AShortPsIsPaddedForTheCoderOnly) {
    type("PS_T", "RADIO");
    click("PS_Taste");
    EXPECT_EQ(sent(), Lines{coder("PS=RADIO   ")});
    EXPECT_EQ(stored("PS"), "RADIO");
    EXPECT_EQ(status(StatusSlot::Ps), "RADIO");
}

TEST_F(RdsPageTest, UmlautsTravelAsOneByteEach) {
    type("PS_T", "M\xC3\xBCnchen \xE2\x82\xAC");
    click("PS_Taste");
    EXPECT_EQ(sent(), Lines{coder("PS=M\xFCnchen ")});
    EXPECT_EQ(folder.read("Datenset1.INI"), "[RDS]\r\nPS=M\xFCnchen \r\n");
}

TEST_F(RdsPageTest, TypingAPiSendsNothing) {
    type("PI_T", "d3c");
    EXPECT_EQ(sent(), Lines{});
    EXPECT_EQ(stored("PI"), "");
    EXPECT_EQ(state.currentPi, "d3c");
}

TEST_F(RdsPageTest, ThePiIsStoredAsTypedAndSentWithFourCharacters) {
    type("PI_T", "d3c");
    click("Command3");
    EXPECT_EQ(sent(), Lines{coder("PI=d3c ")});
    EXPECT_EQ(folder.read("Datenset1.INI"), "[RDS]\r\nPI=d3c\r\n");
    EXPECT_EQ(status(StatusSlot::Pi), "d3c");
    EXPECT_EQ(text("PI_T"), "d3c");
    EXPECT_EQ(state.currentPi, "d3c ");  // the form that was sent
    type("PI_T", "D3C2F");
    click("Command3");
    EXPECT_EQ(sent(), Lines{coder("PI=D3C2")});
    EXPECT_EQ(stored("PI"), "D3C2F");
    EXPECT_EQ(state.currentPi, "D3C2");
}

TEST_F(RdsPageTest, TheReturnKeySendsTheEntryItIsPressedIn) {
    type("PS_T", "RADIO");
    press("PS_T", Qt::Key_Return);
    type("PI_T", "D3C2");
    press("PI_T", Qt::Key_Return);
    type("RT_Text1", "News");
    press("RT_Text1", Qt::Key_Return);
    EXPECT_EQ(sent(), (Lines{coder("PS=RADIO   "), coder("PI=D3C2"), coder("RT=10,0,News")}));
}

TEST_F(RdsPageTest, TheProgrammeTypeGoesToDataSetOneWhateverSetIsCurrent) {
    state.CurrentDataSet = "3";
    select("PTY_Combo1", 12);
    EXPECT_EQ(sent(), Lines{coder("PTY=12")});
    EXPECT_EQ(stored("PTY"), "12");
    select("PTY_Combo1", 0);
    EXPECT_EQ(sent(), Lines{coder("PTY=00")});
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
    EXPECT_TRUE(enabled("TA_Option_0"));
    EXPECT_FALSE(enabled("TA_Option_1"));
    EXPECT_FALSE(enabled("TA_Check"));
}

TEST_F(RdsPageTest, MusicAndSpeech) {
    click("MS_opt_0");
    EXPECT_EQ(status(StatusSlot::MusicSpeech), "Musik");
    EXPECT_EQ(stored("MS"), "M");
    click("MS_opt_1");
    EXPECT_EQ(status(StatusSlot::MusicSpeech), "Sprache");
    EXPECT_EQ(stored("MS"), "S");
    EXPECT_EQ(sent(), (Lines{coder("MS=M"), coder("MS=S")}));
}

TEST_F(RdsPageTest, DecoderInformationIsTheOptionsNumber) {
    for (int i = 0; i < 16; ++i) {
        const std::string number = std::to_string(i);
        click(("DI_Opt_" + number).c_str());
        EXPECT_EQ(sent(), Lines{coder("DI=" + number)});
        EXPECT_EQ(stored("DI"), number);
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
    EXPECT_EQ(sent(), Lines{coder("RT=10,0, News \"1\" ")});
    EXPECT_EQ(folder.read("Datenset1.INI"), "[RDS]\r\nRTA= News \"1\" \r\n");
    EXPECT_EQ(stored("RT"), "");
}

TEST_F(RdsPageTest, ClearingTheRadiotextSendsThreeBlanksAndStoresNothing) {
    type("RT_Text1", "News");
    click("RT_Taste1");
    sent();
    click("RT_clear1");
    EXPECT_EQ(sent(), Lines{coder("RT=10,0,   ")});
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
    EXPECT_EQ(sent(), Lines{coder("CT=09:05:07,05.03.09")});
    clock.set(23 * 3600 + 59 * 60 + 59);
    tick("Timer1");
    EXPECT_EQ(sent(), Lines{coder("CT=23:59:59,05.03.09")});
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

class StoredDataSet : public RdsPageTest {
protected:
    StoredDataSet() {
        folder.write("Datenset1.INI",
                     "[RDS]\r\nPS=ABCDEFGHIJ\r\nPI=D3C2\r\nRTA=News at ten\r\nRTB=Second\r\nMS=M\r\nDI=5\r\nPTY=3\r\n");
        page.loadDataSet();
        page.loadProgrammeType();
    }
};

TEST_F(StoredDataSet, FillsEntriesAndIndicators) {
    EXPECT_EQ(text("PS_T"), "ABCDEFGHIJ");
    EXPECT_EQ(status(StatusSlot::Ps), "ABCDEFGH");
    EXPECT_EQ(text("PI_T"), "D3C2");
    EXPECT_EQ(status(StatusSlot::Pi), "D3C2");
    EXPECT_EQ(text("RT_Text1"), "News at ten");
    EXPECT_EQ(find("RT_Text1")->toolTip(), QStringLiteral("RTB: Second"));
    EXPECT_TRUE(checked("MS_opt_0"));
    EXPECT_EQ(status(StatusSlot::MusicSpeech), "Musik");
    EXPECT_TRUE(checked("DI_Opt_5"));
    EXPECT_EQ(find<QComboBox>("PTY_Combo1")->currentIndex(), 3);
    EXPECT_EQ(status(StatusSlot::Pty), text("PTY_Combo1"));
    EXPECT_FALSE(checked("Taste_PS_Auto"));
}

TEST_F(StoredDataSet, SendsAndStoresNothingByBeingLoaded) {
    EXPECT_EQ(sent(), Lines{});
    EXPECT_EQ(folder.read("Datenset1.INI"),
              "[RDS]\r\nPS=ABCDEFGHIJ\r\nPI=D3C2\r\nRTA=News at ten\r\nRTB=Second\r\nMS=M\r\nDI=5\r\nPTY=3\r\n");
}

TEST_F(StoredDataSet, IsSentAsItStands) {
    page.sendPi();
    page.sendPs();
    page.sendMusicSpeech();
    page.sendRadiotext();
    page.sendProgrammeType();
    EXPECT_EQ(sent(), (Lines{coder("PI=D3C2"), coder("PS=ABCDEFGH"), coder("MS=M"), coder("RT=10,0,News at ten"),
                             coder("PTY=03")}));
}

TEST_F(StoredDataSet, SendsTheTrafficFlagsAsTheWindowShowsThem) {
    page.sendTrafficFlags();
    EXPECT_EQ(sent(), (Lines{":stereo:rds:traffic:program OFF", coder("TA=0")}));
    EXPECT_EQ(status(StatusSlot::Tp), "aus");
    EXPECT_EQ(status(StatusSlot::Ta), "aus");
    EXPECT_FALSE(enabled("TA_Option_1"));  // no traffic programme, no automatic
    EXPECT_FALSE(enabled("TA_Check"));
    click("Check1");
    click("TA_Check");
    sent();
    page.sendTrafficFlags();
    EXPECT_EQ(sent(), (Lines{":stereo:rds:traffic:program ON", coder("TA=1")}));
    EXPECT_TRUE(enabled("TA_Check"));
    EXPECT_FALSE(enabled("TA_Option_1"));  // an announcement by hand is running
}

TEST_F(StoredDataSet, AnotherLanguageKeepsEveryEntryAndChangesWordsOnly) {
    click("Check1");
    sent();
    type("PS_T", "EDITED");
    useLanguage("english");
    page.label();
    EXPECT_EQ(text("PS_T"), "EDITED");
    EXPECT_EQ(text("PI_T"), "D3C2");
    EXPECT_EQ(text("RT_Text1"), "News at ten");
    EXPECT_TRUE(checked("MS_opt_0"));
    EXPECT_TRUE(checked("DI_Opt_5"));
    EXPECT_EQ(status(StatusSlot::Tp), "on");
    EXPECT_EQ(status(StatusSlot::MusicSpeech), "Music");
    EXPECT_EQ(status(StatusSlot::Ps), "ABCDEFGH");
    EXPECT_EQ(text("PTY_Combo1"), captions.programmeType(3));
    EXPECT_EQ(status(StatusSlot::Pty), captions.programmeType(3));
    EXPECT_EQ(text("PS_Taste"), "send");
    EXPECT_EQ(text("Command3"), "send");
    EXPECT_EQ(text("RT_Taste1"), "send");
    EXPECT_EQ(sent(), Lines{});
}

TEST_F(StoredDataSet, AnotherLanguageChangesTheClockWordButNotATime) {
    useLanguage("english");
    page.label();
    EXPECT_EQ(text("Uhr_Zeit"), "off");
    click("Zeit_Taste");
    tick("Timer1");
    useLanguage("deutsch");
    page.label();
    EXPECT_EQ(text("Uhr_Zeit"), "12:00:00");
}

TEST_F(StoredDataSet, ProgrammeTypesFollowLanguageAndStandard) {
    const auto list = [this] {
        Lines names;
        auto* combo = find<QComboBox>("PTY_Combo1");
        for (int i = 0; i < combo->count(); ++i) names.push_back(combo->itemText(i).toStdString());
        return names;
    };
    const Lines german = list();
    EXPECT_EQ(german.size(), 32U);
    useLanguage("deutsch", "RBDS");
    page.label();
    EXPECT_EQ(list(), german);
    useLanguage("english US", "RDS");
    page.label();
    const Lines european = list();
    EXPECT_NE(european, german);
    useLanguage("english US", "RBDS");
    page.label();
    EXPECT_NE(list(), european);
    EXPECT_EQ(list().size(), 32U);
    EXPECT_EQ(find<QComboBox>("PTY_Combo1")->currentIndex(), 3);
}

TEST_F(StoredDataSet, TheArrowKeysChooseAsAClickDoes) {
    page.show();
    page.activateWindow();
    QApplication::processEvents();
    find("MS_opt_0")->setFocus();
    ASSERT_TRUE(find("MS_opt_0")->hasFocus());
    press("MS_opt_0", Qt::Key_Right);
    EXPECT_TRUE(checked("MS_opt_1"));
    EXPECT_EQ(sent(), Lines{coder("MS=S")});
    EXPECT_EQ(stored("MS"), "S");
}

TEST_F(RdsPageTest, AnEmptyDataSetLeavesEntriesEmptyAndOptionsUnchosen) {
    page.loadDataSet();
    page.loadProgrammeType();
    EXPECT_EQ(text("PS_T"), "");
    EXPECT_EQ(text("PI_T"), "");
    EXPECT_FALSE(checked("MS_opt_0"));
    EXPECT_FALSE(checked("MS_opt_1"));
    for (int i = 0; i < 16; ++i) EXPECT_FALSE(checked(("DI_Opt_" + std::to_string(i)).c_str()));
    EXPECT_EQ(find<QComboBox>("PTY_Combo1")->currentIndex(), 0);
    EXPECT_EQ(find("RT_Text1")->toolTip(), QString());
}

TEST_F(RdsPageTest, NumbersOutsideTheListsChooseNothing) {
    for (const char* number : {"32", "-1", "1e300", "99999999999"}) {
        folder.write("Datenset1.INI", std::string("[RDS]\r\nDI=") + number + "\r\nPTY=" + number + "\r\n");
        page.loadDataSet();
        page.loadProgrammeType();
        for (int i = 0; i < 16; ++i) EXPECT_FALSE(checked(("DI_Opt_" + std::to_string(i)).c_str())) << number;
        EXPECT_EQ(find<QComboBox>("PTY_Combo1")->currentIndex(), -1) << number;
    }
}

TEST_F(RdsPageTest, SpeechIsEverythingThatIsNotMusic) {
    setProfile("Datenset1.INI", "RDS", "MS", "S");
    page.loadDataSet();
    EXPECT_TRUE(checked("MS_opt_1"));
    EXPECT_EQ(state.currentMs, "S");
}

}  // namespace
}  // namespace kdx::test
