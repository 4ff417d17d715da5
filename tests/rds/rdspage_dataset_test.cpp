// What the page makes of a stored data set, and what goes out of it when the whole data set does.
#include <gmock/gmock.h>

#include "rdspagetest.h"

namespace kdx::test {
namespace {

using namespace std::string_literals;

class StoredDataSet : public RdsPageTest {
protected:
    StoredDataSet() {
        folder.write("Datenset1.INI",
                     "[RDS]\r\nPS=ABCDEFGHIJ\r\nPI=D3C2\r\nRTA=News at ten\r\nRTB=Second\r\nMS=M\r\nDI=5\r\nPTY=3\r\n");
        load();
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
    EXPECT_TRUE(checked("Zeit_Taste"));
}

TEST_F(StoredDataSet, SendsAndStoresNothingByBeingLoaded) {
    EXPECT_EQ(sent(), Lines{});
    EXPECT_EQ(folder.read("Datenset1.INI"),
              "[RDS]\r\nPS=ABCDEFGHIJ\r\nPI=D3C2\r\nRTA=News at ten\r\nRTB=Second\r\nMS=M\r\nDI=5\r\nPTY=3\r\n");
}

TEST_F(StoredDataSet, IsSentAsItStands) {
    sendProgramme();
    EXPECT_EQ(sent(),
              (Lines{direct("PI=D3C2"), ":stereo:rds:traffic:program OFF", direct("TA=0"), direct("PS=ABCDEFGH"),
                     direct("BIN=0"), direct("MS=M"), direct("RT=10,0,News at ten"), direct("PTY=03")}));
}

TEST_F(StoredDataSet, SendsTheTrafficFlagsAsTheWindowShowsThem) {
    sendProgramme();
    EXPECT_THAT(sent(), ::testing::IsSupersetOf({":stereo:rds:traffic:program OFF"s, direct("TA=0")}));
    EXPECT_EQ(status(StatusSlot::Tp), "aus");
    EXPECT_EQ(status(StatusSlot::Ta), "aus");
    EXPECT_TRUE(enabled("TA_Option_0"));
    EXPECT_FALSE(enabled("TA_Option_1"));  // no traffic programme, no automatic
    EXPECT_FALSE(enabled("TA_Check"));
    click("Check1");
    click("TA_Check");
    sent();
    sendProgramme();
    EXPECT_THAT(sent(), ::testing::IsSupersetOf({":stereo:rds:traffic:program ON"s, direct("TA=1")}));
    EXPECT_EQ(status(StatusSlot::Tp), "ein");
    EXPECT_EQ(status(StatusSlot::Ta), "ein");
    EXPECT_TRUE(enabled("TA_Check"));
    EXPECT_FALSE(enabled("TA_Option_1"));  // an announcement by hand is running
}

TEST_F(StoredDataSet, IndicatorsFollowTheFlagsThatGoOut) {
    page.stepGoesOut({.key = "TP", .value = "1"});
    EXPECT_EQ(status(StatusSlot::Tp), "ein");
    EXPECT_TRUE(enabled("TA_Check"));
    page.stepGoesOut({.key = "PS", .value = "OTHER"});
    EXPECT_EQ(status(StatusSlot::Ps), "OTHER");
    EXPECT_EQ(text("PS_T"), "ABCDEFGHIJ");  // what was typed stays
    EXPECT_EQ(sent(), Lines{});             // sending is for whoever runs the sequence
}

TEST_F(StoredDataSet, SwitchesTheClockOnOnceHoweverOftenItIsLoaded) {
    EXPECT_TRUE(checked("Zeit_Taste"));
    load();
    EXPECT_TRUE(checked("Zeit_Taste"));
    click("Zeit_Taste");
    load();
    EXPECT_FALSE(checked("Zeit_Taste"));
}

TEST_F(StoredDataSet, TheProgrammeTypeThatGoesOutIsTheOneChosenInTheList) {
    EXPECT_EQ(programme.pty, "3");
    setProfile("Datenset1.INI", "RDS", "PTY", "7");
    page.label();  // reads the type anew
    EXPECT_EQ(programme.pty, "7");
    setProfile("Datenset1.INI", "RDS", "PTY", "32");
    page.label();
    EXPECT_EQ(programme.pty, "-1");
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
    EXPECT_EQ(state.shownClock, "off");
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
    EXPECT_EQ(sent(), Lines{direct("MS=S")});
    EXPECT_EQ(stored("MS"), "S");
}

TEST_F(RdsPageTest, AnEmptyDataSetLeavesEntriesEmptyAndOptionsUnchosen) {
    load();
    EXPECT_EQ(text("PS_T"), "");
    EXPECT_EQ(text("PI_T"), "");
    EXPECT_FALSE(checked("MS_opt_0"));
    EXPECT_FALSE(checked("MS_opt_1"));
    for (int i = 0; i < 16; ++i) EXPECT_FALSE(checked(("DI_Opt_" + std::to_string(i)).c_str()));
    EXPECT_EQ(find<QComboBox>("PTY_Combo1")->currentIndex(), 0);
    EXPECT_EQ(find("RT_Text1")->toolTip(), QString());
}

TEST_F(RdsPageTest, TheLastEntriesOfTheListsCanBeStored) {
    folder.write("Datenset1.INI", "[RDS]\r\nDI=15\r\nPTY=31\r\n");
    load();
    EXPECT_TRUE(checked("DI_Opt_15"));
    EXPECT_EQ(find<QComboBox>("PTY_Combo1")->currentIndex(), 31);
}

TEST_F(RdsPageTest, NumbersOutsideTheListsChooseNothing) {
    for (const char* number : {"32", "-1", "1e300", "99999999999"}) {
        folder.write("Datenset1.INI", std::string("[RDS]\r\nDI=") + number + "\r\nPTY=" + number + "\r\n");
        load();
        for (int i = 0; i < 16; ++i) EXPECT_FALSE(checked(("DI_Opt_" + std::to_string(i)).c_str())) << number;
        EXPECT_EQ(find<QComboBox>("PTY_Combo1")->currentIndex(), -1) << number;
    }
}

TEST_F(RdsPageTest, SpeechIsEverythingThatIsNotMusic) {
    setProfile("Datenset1.INI", "RDS", "MS", "S");
    load();
    EXPECT_TRUE(checked("MS_opt_1"));
    EXPECT_EQ(programme.musicSpeech, "S");
}

}  // namespace
}  // namespace kdx::test
