// Data sets as a whole: which one is at work, and keeping what the window holds.
#include <gtest/gtest.h>

#include <QListWidget>
#include <QMenu>

#include "ui/text.h"
#include "window/datasetstest.h"

namespace kdx::test {
namespace {

TEST_F(DataSetsTest, TheMenuTellsEachSetByItsNumberPsAndPi) {
    start();
    EXPECT_EQ(action("Mnu_Datensatz_1")->text().toStdString(), "&1  MESSTURM  D7A1");
    EXPECT_EQ(action("Mnu_Datensatz_3")->text().toStdString(), "&3  KLANGHOF  D7A3");
    EXPECT_TRUE(action("Mnu_Datensatz_1")->isChecked());
    EXPECT_EQ(text("Datensatz_Anzeige"), "1");
}

TEST_F(DataSetsTest, ChoosingASetShowsWhatItHoldsOnAllPages) {
    start();
    choose(3);
    EXPECT_EQ(text("Datensatz_Anzeige"), "3");
    EXPECT_TRUE(action("Mnu_Datensatz_3")->isChecked());
    EXPECT_FALSE(action("Mnu_Datensatz_1")->isChecked());
    EXPECT_EQ(text("PS_T"), "KLANGHOF");
    EXPECT_EQ(text("PI_T"), "D7A3");
    EXPECT_EQ(text("Status_2"), "D7A3");
    EXPECT_EQ(text("Status_3"), "KLANGHOF");
    EXPECT_EQ(find<QComboBox>("PTY_Combo1")->currentIndex(), 14);
    EXPECT_TRUE(checked("DI_Opt_3"));
    EXPECT_EQ(text("RT_Text1"), "Klanghof - Konzert in Kunstkopf-Stereo");
    EXPECT_EQ(text("EON_PI_Text"), "D7A4");
    EXPECT_EQ(text("EON_PS_Text"), "ABPFIFF");
    EXPECT_EQ(find<QComboBox>("EON_PTY_Combo")->currentIndex(), 4);
    EXPECT_EQ(find<QListWidget>("AF_List1")->item(0)->text().toStdString(), "87.9");
    EXPECT_EQ(state.eonIdentifier, "D7A4");
}

TEST_F(DataSetsTest, ASetThatWasChosenIsShownAndSentAlsoWhereSet1IsReadOtherwise) {
    start();
    choose(3);
    showPage(3);
    EXPECT_EQ(text("Label10"), "Gruppenfolge:0A,2A,4A,");
    action("Mnu_Info_Sprache_E")->trigger();
    EXPECT_EQ(find<QComboBox>("PTY_Combo1")->currentIndex(), 14);
    EXPECT_EQ(find<QComboBox>("EON_PTY_Combo")->currentIndex(), 4);
    openSession();
    const Lines lines = sent();
    for (const char* line : {R"(:STEREO:DIRECT "PS=KLANGHOF")", R"(:STEREO:DIRECT "PI=D7A3")",
                             R"(:STEREO:DIRECT "GS=0A,2A,4A")", R"(:STEREO:DIRECT "PTY=14")"})
        EXPECT_NE(std::find(lines.begin(), lines.end(), line), lines.end()) << line;
}

TEST_F(DataSetsTest, ASetThatIsNotToBeSentIsOnlyShown) {
    start();
    openSession();
    visa.written.clear();
    dialogs.confirmations = {false};
    choose(2);
    EXPECT_EQ(sent(), Lines{});
    EXPECT_EQ(text("Datensatz_Anzeige"), "2");
}

TEST_F(DataSetsTest, WithoutASessionNothingIsAskedOrSentAndNoSettingChanges) {
    start();
    const std::string general = folder.read("RDS_Allg.INI");
    const std::string first = folder.read("Datenset1.INI");
    const std::string fourth = folder.read("Datenset4.INI");
    choose(4);
    EXPECT_EQ(sent(), Lines{});
    EXPECT_TRUE(dialogs.shown.empty());
    EXPECT_EQ(folder.read("RDS_Allg.INI"), general);
    EXPECT_EQ(folder.read("Datenset1.INI"), first);
    EXPECT_EQ(folder.read("Datenset4.INI"), fourth);
}

TEST_F(DataSetsTest, RfLevelAndAudioStayThoseOfSet1) {
    setDataSet1("VRN", "HF_Frequenz", "98.5");
    start();
    choose(3);
    openSession();
    const Lines lines = sent();
    EXPECT_NE(std::find(lines.begin(), lines.end(), "FREQ 98.5MHZ"), lines.end()) << "of set 1";
    EXPECT_EQ(text("Status_17"), "98.5");
}

TEST_F(DataSetsTest, WhatIsChangedIsStoredInTheSetAtWork) {
    start();
    choose(3);
    openSession();
    type("PS_T", "NEU");
    click("PS_Taste");
    EXPECT_EQ(stored(3, "PS"), "NEU");
    EXPECT_EQ(stored(1, "PS"), "MESSTURM");
}

TEST_F(DataSetsTest, WhatASetLeavesOutDoesNotStayFromTheOneBefore) {
    folder.write("Datenset5.INI", "[RDS]\r\nPS=LEER\r\n");
    start();
    choose(5);
    EXPECT_EQ(text("PI_T"), "");
    EXPECT_EQ(text("Status_2"), "");
    EXPECT_EQ(text("Status_1"), "") << "music or speech";
    EXPECT_FALSE(checked("MS_opt_0") || checked("MS_opt_1"));
    EXPECT_EQ(text("RT_Text1"), "");
}

TEST_F(DataSetsTest, AfterARestartSet1IsAtWork) {
    start();
    choose(3);
    start();
    EXPECT_EQ(text("Datensatz_Anzeige"), "1");
    EXPECT_EQ(text("PS_T"), "MESSTURM");
}

TEST_F(DataSetsTest, AnAnnouncementOfTheNetworkLeftBehindEnds) {
    setDataSet1("RDS", "EON_PI", "D3C1");
    setDataSet1("RDS", "EON_TP", "1");
    setDataSet1("RDS", "EON_TA", "0");
    start();
    openSession();
    showPage(4);
    find<QLabel>("Status_10")->setText(QStringLiteral("aus"));
    find<QLabel>("Status_0")->setText(QStringLiteral("ein"));
    click("EON_TA_Schalter");
    visa.written.clear();
    dialogs.confirmations = {false};
    choose(2);
    const Lines lines = sent();
    ASSERT_EQ(lines.size(), 1U);
    EXPECT_NE(lines.front().find("D3C1"), std::string::npos) << lines.front();
    EXPECT_FALSE(tick("EON_TA_Zeit"));
}

TEST_F(DataSetsTest, SavingAsASetAsksAndKeepsWhatTheWindowHolds) {
    start();
    type("PS_T", "GETIPPT");  // not sent yet
    select("PTY_Combo1", 9);
    dialogs.confirmations = {true};
    action("Mnu_Datensatz_Sichern_2")->trigger();
    EXPECT_EQ(dialogs.shown.back().text.toStdString().substr(0, 12), "Datensatz 2 ");
    EXPECT_EQ(stored(2, "PS"), "GETIPPT");
    EXPECT_EQ(stored(2, "PI"), "D7A1");
    EXPECT_EQ(stored(2, "PTY"), "9");
    EXPECT_EQ(stored(2, "AF_LISTE1"), stored(1, "AF_LISTE1"));
    EXPECT_EQ(stored(1, "PS"), "MESSTURM");
    EXPECT_EQ(text("Datensatz_Anzeige"), "1") << "the set at work stays";
    EXPECT_EQ(action("Mnu_Datensatz_2")->text().toStdString(), "&2  GETIPPT  D7A1");
}

TEST_F(DataSetsTest, SavingCanBeRefused) {
    start();
    const std::string before = folder.read("Datenset2.INI");
    dialogs.confirmations = {false};
    action("Mnu_Datensatz_Sichern_2")->trigger();
    EXPECT_EQ(folder.read("Datenset2.INI"), before);
}

TEST_F(DataSetsTest, NothingOfASetThatIsOverwrittenStays) {
    folder.write("Datenset4.INI", "[RDS]\r\nPS=ALT\r\nAF_LISTE3=99.9,88.8\r\nUnknown=1\r\n[VRN]\r\nx=1\r\n");
    folder.write("Datenset1.INI", "[RDS]\r\nPS=\" AB \"\r\nPI=D3C0\r\n");
    start();
    dialogs.confirmations = {true};
    action("Mnu_Datensatz_Sichern_4")->trigger();
    EXPECT_EQ(stored(4, "AF_LISTE3"), "");
    EXPECT_EQ(stored(4, "Unknown"), "");
    EXPECT_EQ(stored(4, "PS"), " AB ") << "its blanks are kept as they were stored";
    EXPECT_EQ(data.ReadIni("VRN", "x", "Datenset4.INI"), "1");
}

TEST_F(DataSetsTest, ASetThatIsMissingIsMadeWithoutAQuestion) {
    std::filesystem::remove(folder.data() / "Datenset5.INI");
    start();
    action("Mnu_Datensatz_Sichern_5")->trigger();
    EXPECT_EQ(stored(5, "PS"), "MESSTURM");
}

TEST_F(DataSetsTest, ASetThatCannotBeSavedIsTold) {
    std::filesystem::remove(folder.data() / "Datenset5.INI");
    std::filesystem::create_directory(folder.data() / "Datenset5.INI");
    start();
    dialogs.expectedMessages = 1;
    action("Mnu_Datensatz_Sichern_5")->trigger();
    EXPECT_EQ(dialogs.shown.back().text.toStdString(), "Nicht gespeichert: Datenset5.INI");
}

TEST_F(DataSetsTest, AnyFileCanBeOpenedAndIsAtWorkThen) {
    folder.write("../bench.ini", "[RDS]\r\nPS=BENCH\r\nPI=1234\r\n");
    start();
    dialogs.files = {file("bench.ini")};
    action("Mnu_Datensatz_Oeffnen")->trigger();
    EXPECT_EQ(text("PS_T"), "BENCH");
    EXPECT_EQ(text("Datensatz_Anzeige"), "bench.ini");
    for (int set = 1; set <= 5; ++set)
        EXPECT_FALSE(action(("Mnu_Datensatz_" + std::to_string(set)).c_str())->isChecked());
    openSession();
    type("PS_T", "OTHER");
    click("PS_Taste");
    EXPECT_EQ(atLarge("bench.ini", "PS"), "OTHER");
    EXPECT_EQ(stored(1, "PS"), "MESSTURM");
    dialogs.confirmations = {false};
    choose(2);
    EXPECT_EQ(text("Datensatz_Anzeige"), "2");
    click("PS_Taste");
    EXPECT_EQ(atLarge("bench.ini", "PS"), "OTHER");
}

TEST_F(DataSetsTest, OpeningTheFileOfASetChoosesThatSet) {
    start();
    dialogs.files = {file("Daten/Datenset3.INI")};
    action("Mnu_Datensatz_Oeffnen")->trigger();
    EXPECT_EQ(text("Datensatz_Anzeige"), "3");
}

TEST_F(DataSetsTest, AFileWithoutADataSetIsRefused) {
    folder.write("../letter.txt", "Dear reader\r\n");
    start();
    dialogs.files = {file("letter.txt"), file("missing.ini"), QString()};
    dialogs.expectedMessages = 2;
    for (int i = 0; i < 3; ++i) action("Mnu_Datensatz_Oeffnen")->trigger();
    EXPECT_EQ(dialogs.shown[1].text.toStdString(), "In letter.txt ist kein Datensatz.");
    EXPECT_EQ(text("Datensatz_Anzeige"), "1");
    EXPECT_EQ(text("PS_T"), "MESSTURM");
}

TEST_F(DataSetsTest, AFileOpenedInVainIsNoLastingProblem) {
    folder.write("../utf16.INI", std::string("\xFF\xFE[\0R\0", 6));
    std::ofstream(folder.path() / "huge.INI") << "[RDS]\r\nPS=HUGE\r\n";
    std::filesystem::resize_file(folder.path() / "huge.INI", 50'000'000);
    start();
    dialogs.files = {file("utf16.INI"), file("huge.INI")};
    dialogs.expectedMessages = 2;
    for (int i = 0; i < 2; ++i) action("Mnu_Datensatz_Oeffnen")->trigger();
    EXPECT_EQ(dialogs.shown.back().text.toStdString(), "In huge.INI ist kein Datensatz.");
    EXPECT_EQ(text("QuietLine"), "");
}

TEST_F(DataSetsTest, WhatTheWindowHoldsCanBeSavedToAnyFile) {
    start();
    type("RT_Text1", "Getippt");
    dialogs.files = {file("copy.ini")};
    action("Mnu_Datensatz_Sichern_unter")->trigger();
    EXPECT_EQ(atLarge("copy.ini", "RTA"), "Getippt");
    EXPECT_EQ(atLarge("copy.ini", "PI"), "D7A1");
    EXPECT_EQ(text("Datensatz_Anzeige"), "1");
}

TEST_F(DataSetsTest, ASetCanBeGivenAName) {
    start();
    choose(2);
    dialogs.inputs = {QStringLiteral("Prüfstand & Labor")};
    action("Mnu_Datensatz_Umbenennen")->trigger();
    EXPECT_EQ(toText(data.ReadIni("Datensatz", "Name", "Datenset2.INI")), QStringLiteral("Prüfstand & Labor"));
    EXPECT_TRUE(action("Mnu_Datensatz_2")->text().endsWith(QStringLiteral("  Prüfstand && Labor")));
    dialogs.inputs = {QString()};
    action("Mnu_Datensatz_Umbenennen")->trigger();
    EXPECT_EQ(dialogs.shown.back().preset, QStringLiteral("Prüfstand & Labor"));
    EXPECT_TRUE(action("Mnu_Datensatz_2")->text().contains(QStringLiteral("Prüfstand")));
}

TEST_F(DataSetsTest, TheShippedSetComesBackAfterAQuestion) {
    data.WriteIni("RDS", "PS", "VERSTELLT", "Datenset3.INI");
    data.WriteIni("RDS", "TMC2", "x", "Datenset3.INI");
    startWithShipped();
    choose(3);
    EXPECT_EQ(text("PS_T"), "VERSTELLT");
    dialogs.confirmations = {false, true};
    action("Mnu_Datensatz_Auslieferung")->trigger();
    EXPECT_EQ(stored(3, "PS"), "VERSTELLT");
    action("Mnu_Datensatz_Auslieferung")->trigger();
    EXPECT_EQ(stored(3, "PS"), "KLANGHOF");
    EXPECT_EQ(stored(3, "TMC2"), "");
    EXPECT_EQ(text("PS_T"), "KLANGHOF");
    EXPECT_EQ(text("Datensatz_Anzeige"), "3");
}

TEST_F(DataSetsTest, AFileOfTheUsersOwnHasNoShippedOne) {
    folder.write("../bench.ini", "[RDS]\r\nPS=BENCH\r\n");
    startWithShipped();
    EXPECT_TRUE(action("Mnu_Datensatz_Auslieferung")->isEnabled());
    dialogs.files = {file("bench.ini")};
    action("Mnu_Datensatz_Oeffnen")->trigger();
    EXPECT_FALSE(action("Mnu_Datensatz_Auslieferung")->isEnabled());
    start();
    shipped.clear();
    start();
    EXPECT_FALSE(action("Mnu_Datensatz_Auslieferung")->isEnabled());
}

}  // namespace
}  // namespace kdx::test
