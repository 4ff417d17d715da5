#include <gtest/gtest.h>

#include "window/startuptest.h"

namespace kdx::test {
namespace {

TEST_F(StartUpTest, ShowsTheProgramsTitleWithItsBlanks) {
    startShipped();
    EXPECT_EQ(window->windowTitle().toStdString(), "KDX-RDS V 1.0  / Mar. 2009  ");
    EXPECT_EQ(state.ProgramTitle, "KDX-RDS V 1.0  / Mar. 2009  ");
}

TEST_F(StartUpTest, TheWindowHasItsDesignSize) {
    startShipped();
    EXPECT_EQ(window->size(), QSize(640, 480));
}

TEST_F(StartUpTest, AFirstStartWithoutDataShowsEmptyEntriesAndTheGpibMode) {
    std::filesystem::remove_all(folder.data());
    start();
    EXPECT_EQ(text("INIT_Taste"), "Init IEEE");
    EXPECT_TRUE(find("Label6")->isVisible());
    for (const char* entry : {"PS_T", "PI_T", "RT_Text1", "EON_PI_Text", "EON_PS_Text"}) EXPECT_EQ(text(entry), "");
    for (const char* option : {"MS_opt_0", "MS_opt_1", "FM_Imp_Opt_0", "FM_Imp_Opt_1", "Stereo_Opt_0"}) {
        EXPECT_FALSE(checked(option)) << option;
    }
    EXPECT_EQ(find<QScrollBar>("FM_Hub_Scroll")->value(), 0);
    EXPECT_EQ(state.CurrentDataSet, "1");
    EXPECT_FALSE(state.LogEnabled);
    EXPECT_FALSE(std::filesystem::exists(folder.data() / kGeneralSettings));
}

TEST_F(StartUpTest, NothingIsSentWithoutAnOpenSession) {
    startShipped();
    EXPECT_EQ(sent(), Lines{});
    EXPECT_EQ(visa.calls, Lines{});
    EXPECT_FALSE(state.InstrumentOnline);
}

TEST_F(StartUpTest, TakesNoPauses) {
    startShipped();
    EXPECT_TRUE(clock.sleeps.empty());
}

TEST_F(StartUpTest, BeginsInTheClosedSessionState) {
    startShipped();
    for (const char* off : {"SSTab1", "Frame7"}) EXPECT_FALSE(find(off)->isEnabled()) << off;
    for (const char* on : {"Frame8", "INIT_Taste", "Ende_Taste"}) EXPECT_TRUE(find(on)->isEnabled()) << on;
}

TEST_F(StartUpTest, FillsTheControlsFromDataSet1) {
    folder.copyShipped();
    setDataSet1("RDS", "PS", "TESTFUNK");
    setDataSet1("RDS", "PI", "D3C2");
    setDataSet1("RDS", "RTA", "Hallo Welt");
    setDataSet1("RDS", "MS", "S");
    setDataSet1("RDS", "DI", "5");
    setDataSet1("RDS", "PTY", "3");
    start();
    EXPECT_EQ(text("PS_T"), "TESTFUNK");
    EXPECT_EQ(text("Status_3"), "TESTFUNK");
    EXPECT_EQ(text("PI_T"), "D3C2");
    EXPECT_EQ(text("Status_2"), "D3C2");
    EXPECT_EQ(text("RT_Text1"), "Hallo Welt");
    EXPECT_TRUE(checked("MS_opt_1"));
    EXPECT_EQ(text("Status_1"), "Sprache");
    EXPECT_TRUE(checked("DI_Opt_5"));
    EXPECT_EQ(find<QComboBox>("PTY_Combo1")->currentIndex(), 3);
    EXPECT_FALSE(checked("Taste_PS_Auto"));
    EXPECT_FALSE(find<QTimer>("EON_TA_Zeit")->isActive());
}

TEST_F(StartUpTest, FlagPictureAndStoredValueOfTheSwitchesStayWhatTheFileSaid) {
    folder.copyShipped();
    for (const auto& [key, button] : {std::pair{"PILOT", "Pilot_OnOff"}, {"ARI", "Ari_OnOff"}, {"RDS", "RDS_OnOff"}}) {
        for (const char* stored : {"1", "0"}) {
            setGeneral("FM", key, stored);
            for (int starts = 0; starts < 3; ++starts) {
                start();
                EXPECT_EQ(checked(button), std::string(stored) == "1") << key << " start " << starts;
                EXPECT_EQ(general("FM", key), stored) << key << " start " << starts;
            }
        }
    }
}

TEST_F(StartUpTest, AStartChangesNoSetting) {
    folder.copyShipped();
    const auto files = {"RDS_Allg.INI", "Datenset1.INI", "Datenset2.INI", "Sprachen.ini"};
    std::map<std::string, std::string> before;
    for (const char* file : files) before[file] = folder.read(file);
    start();
    start();
    for (const char* file : files) EXPECT_EQ(folder.read(file), before[file]) << file;
}

TEST_F(StartUpTest, AStoredImpedanceOf1ChoosesTheFirstOption) {
    folder.copyShipped();
    setGeneral("FM", "MPX_IMPEDANZ", "1");
    start();
    EXPECT_TRUE(checked("FM_Imp_Opt_0"));
    setGeneral("FM", "MPX_IMPEDANZ", "2");
    start();
    EXPECT_TRUE(checked("FM_Imp_Opt_1"));
    setGeneral("FM", "MPX_IMPEDANZ", "0");
    start();
    EXPECT_FALSE(checked("FM_Imp_Opt_0") || checked("FM_Imp_Opt_1"));
}

TEST_F(StartUpTest, TheLogIsEmptyAfterEveryStart) {
    folder.copyShipped();
    setGeneral("ADRESSEN", "Log_Key", "1");
    folder.write("RDS_Log.txt", "old lines\r\n");
    start();
    EXPECT_TRUE(state.LogEnabled);
    EXPECT_EQ(folder.read("RDS_Log.txt"), "");
    EXPECT_NE(std::filesystem::exists(folder.data() / "RDS_log.txt"), folder.tellsLetterCaseApart());
}

TEST_F(StartUpTest, OnlyALogKeyOf1SwitchesTheLogOn) {
    folder.copyShipped();
    for (const auto& [value, on] : {std::pair{"1", true}, {"1.0 x", true}, {"2", false}, {"", false}, {"on", false}}) {
        setGeneral("ADRESSEN", "Log_Key", value);
        start();
        EXPECT_EQ(state.LogEnabled, on) << value;
    }
}

TEST_F(StartUpTest, AutoInAnyLetterCaseOpensTheSession) {
    folder.copyShipped();
    setGeneral("BUS", "IECBUS", "auto");
    start();
    EXPECT_TRUE(state.InstrumentOnline);
    EXPECT_FALSE(sent().empty());
}

TEST_F(StartUpTest, AnyOtherValueDoesNotOpenTheSession) {
    folder.copyShipped();
    for (const char* value : {"1", "", "AUTOMATIC"}) {
        setGeneral("BUS", "IECBUS", value);
        start();
        EXPECT_FALSE(state.InstrumentOnline) << value;
    }
}

TEST_F(StartUpTest, SelectsTheFirstPatternAndSwitchesTheClockOn) {
    startShipped();
    EXPECT_TRUE(checked("TestDat_Opt_0"));
    EXPECT_TRUE(checked("Zeit_Taste"));
    EXPECT_EQ(find<QTimer>("Timer1")->interval(), 20000);
    EXPECT_EQ(text("Uhr_Zeit"), "aus");
}

TEST_F(StartUpTest, HidesThePhaseOfTheRdsSubcarrier) {
    startShipped();
    EXPECT_TRUE(find("RDS_Phase_Label")->isHidden());
    EXPECT_TRUE(find("RDS_Phase_Scroll")->isHidden());
}

TEST_F(StartUpTest, GarbageInTheSettingsStopsNothing) {
    folder.copyShipped();
    std::string garbage("\0[\x01=\xFF]]\r[BUS\n=\n", 15);
    garbage += std::string(std::size_t{1024} * 1024, 'x');
    for (const char* file : {"RDS_Allg.INI", "Datenset1.INI", "Sprachen.ini", "Sch_On.ico", "Event.txt"})
        folder.write(file, garbage);
    start();
    EXPECT_EQ(text("INIT_Taste"), "Init IEEE");
    EXPECT_EQ(text("QuietLine"), "Nicht gefunden: Sprachen.ini [deutsch]");
    expectToWork();
}

class SettingsThatMakeNoSense : public StartUpTest, public ::testing::WithParamInterface<std::string> {};

TEST_P(SettingsThatMakeNoSense, StopNothing) {
    folder.copyShipped();
    for (const char* file : {"RDS_Allg.INI", "Datenset1.INI"}) {
        ProfileText profileFile(folder.read(file));
        for (const char* section : {"FM", "RDS", "VRN"}) {
            for (const auto& [key, value] : profileFile.section(section))
                profileFile.setValue(section, key, GetParam());
        }
        folder.write(file, profileFile.bytes());
    }
    start();
    expectToWork();
}

INSTANTIATE_TEST_SUITE_P(Values, SettingsThatMakeNoSense,
                         ::testing::Values("", "-1", "6", "99999999999", "-99999999999", "1e308", "-1e999", "0x7F",
                                           "nan", ",", ",,,,", "100.5,", "\"", "\x01\xFF", "%1%n",
                                           std::string(300, '9'), std::string(300, ','), std::string(5000, 'A')));

TEST_F(StartUpTest, AMissingDataFolderIsNamedAndTheWindowWorksWithoutIt) {
    std::filesystem::remove_all(folder.data());
    start();
    EXPECT_EQ(text("QuietLine"), "Nicht gefunden / not found: " + (folder.data() / kLanguageFile).string() +
                                     "  -  Nicht gespeichert: RDS_Allg.INI  -  Nicht gespeichert: RDS_log.txt");
    expectToWork();
    EXPECT_FALSE(std::filesystem::exists(folder.data()));
}

TEST_F(StartUpTest, AnUnknownLanguageIsTold) {
    folder.copyShipped();
    setGeneral("Sprache", "Sprache", "francais");
    start();
    EXPECT_EQ(text("QuietLine"), "Nicht gefunden: Sprachen.ini [francais]");
    action("Mnu_Info_Sprache_E")->trigger();
    EXPECT_EQ(text("QuietLine"), "");
}

TEST_F(StartUpTest, AMissingEventListLeavesTheBoxEmptyAndIsTold) {
    folder.copyShipped();
    std::filesystem::remove(folder.data() / kEventList);
    start();
    EXPECT_EQ(find<QComboBox>("TMC_Event_Combo")->count(), 0);
    EXPECT_NE(text("QuietLine").find(kEventList), std::string::npos);
}

TEST_F(StartUpTest, AMissingLanguageFileIsTold) {
    folder.copyShipped();
    std::filesystem::remove(folder.data() / kLanguageFile);
    start();
    EXPECT_EQ(text("QuietLine"), "Nicht gefunden / not found: " + (folder.data() / kLanguageFile).string());
    EXPECT_EQ(find<QTabWidget>("SSTab1")->tabText(0), QString());
    EXPECT_EQ(text("GTL_Taste"), "Local");  // the program's own texts stay as designed
}

TEST_F(StartUpTest, AValueThatCouldNotBeSavedIsTriedAgainByItselfAndAtTheEnd) {
    startShipped();
    openSession();
    const auto file = folder.data() / dataSetFile("1");
    const std::string content = folder.read(dataSetFile("1"));
    const auto hinder = [&] {
        std::filesystem::remove(file);
        std::filesystem::create_directories(file / "x");
    };
    hinder();
    type("PS_T", "SPAETER");
    click("PS_Taste");
    EXPECT_NE(text("QuietLine").find("Datenset1.INI"), std::string::npos);
    std::filesystem::remove_all(file);
    folder.write("Datenset1.INI", content);
    EXPECT_TRUE(tick("UnsavedTimer"));
    EXPECT_EQ(data.ReadIni("RDS", "PS", "Datenset1.INI"), "SPAETER");
    EXPECT_NE(folder.read("Datenset1.INI").find("PS=SPAETER"), std::string::npos);
    EXPECT_EQ(text("QuietLine"), "");
    hinder();
    type("PS_T", "ZULETZT");
    click("PS_Taste");
    std::filesystem::remove_all(file);
    folder.write("Datenset1.INI", content);
    window.reset();
    EXPECT_NE(folder.read("Datenset1.INI").find("PS=ZULETZT"), std::string::npos);
}

TEST_F(StartUpTest, ASettingThatCannotBeSavedIsNamedUntilItCan) {
    startShipped();
    openSession();
    const auto file = folder.data() / dataSetFile("1");
    const std::string content = folder.read(dataSetFile("1"));
    std::filesystem::remove(file);
    std::filesystem::create_directory(file);  // a folder in the file's place cannot be written, not even by root
    std::filesystem::create_directory(file / "x");
    click("PS_Taste");
    EXPECT_NE(text("QuietLine").find("Datenset1.INI"), std::string::npos);
    std::filesystem::remove_all(file);
    folder.write("Datenset1.INI", content);
    type("PS_T", "ANDERES");
    click("PS_Taste");
    EXPECT_EQ(text("QuietLine"), "");
}

}  // namespace
}  // namespace kdx::test
