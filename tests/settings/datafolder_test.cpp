#include "settings/datafolder.h"

#include <gtest/gtest.h>

#include "settings/datafoldertest.h"
#include "settings/programstate.h"

namespace kdx {
namespace {

namespace fs = std::filesystem;

TEST_F(DataFolderTest, DataSetFilesAreNamedByTheirNumber) {
    EXPECT_EQ(dataSetFile("1"), "Datenset1.INI");
    EXPECT_EQ(dataSetFile("5"), "Datenset5.INI");
}

TEST_F(DataFolderTest, TheFolderItselfIsFoundInAnyLetterCase) {
    if (!m_folder.tellsLetterCaseApart()) GTEST_SKIP() << "names of files have no letter case here";
    fs::remove_all(m_folder.data());
    fs::create_directory(m_folder.path() / "dATEN");
    EXPECT_EQ(DataFolder(m_folder.path()).path(), m_folder.path() / "dATEN");
    fs::create_directory(m_folder.data());
    EXPECT_EQ(DataFolder(m_folder.path()).path(), m_folder.data()) << "the exact spelling wins";
}

TEST_F(DataFolderTest, TheFolderNeedNotExist) {
    const fs::path missing = m_folder.path() / "missing";
    DataFolder data(missing);
    EXPECT_EQ(data.path(), missing / "Daten");
    EXPECT_EQ(data.ReadIni("RDS", "PS", "Datenset1.INI"), "");
    data.WriteIni("RDS", "PS", "RADIO", "Datenset1.INI");
    EXPECT_EQ(data.unsavedFile(), "Datenset1.INI");
    EXPECT_FALSE(fs::exists(missing));
}

TEST_F(DataFolderTest, AFileIsFoundInAnyLetterCaseAndTheExactSpellingWins) {
    if (!m_folder.tellsLetterCaseApart()) GTEST_SKIP() << "names of files have no letter case here";
    EXPECT_EQ(m_data.file("RDS_Allg.INI"), m_folder.data() / "RDS_Allg.INI") << "where it would be created";
    m_folder.write("rds_ALLG.ini", "");
    EXPECT_EQ(m_data.file("RDS_Allg.INI"), m_folder.data() / "rds_ALLG.ini");
    m_folder.write("RDS_Allg.INI", "");
    EXPECT_EQ(m_data.file("RDS_Allg.INI"), m_folder.data() / "RDS_Allg.INI");
}

TEST_F(DataFolderTest, AmongSeveralOtherSpellingsTheChoiceIsAlwaysTheSame) {
    if (!m_folder.tellsLetterCaseApart()) GTEST_SKIP() << "names of files have no letter case here";
    m_folder.write("test.ini", "");
    m_folder.write("TEST.ini", "");
    m_folder.write("Test.ini", "");
    EXPECT_EQ(m_data.file("TEST.INI"), m_folder.data() / "TEST.ini");
}

TEST_F(DataFolderTest, AValueWrittenIsReadBack) {
    m_data.WriteIni("BUS", "Interface", "TCPIP", "RDS_Allg.INI");
    EXPECT_EQ(m_data.ReadIni("BUS", "INTERFACE", "RDS_ALLG.INI"), "TCPIP");
    EXPECT_EQ(m_folder.read("RDS_Allg.INI"), "[BUS]\r\nInterface=TCPIP\r\n");
    EXPECT_EQ(m_data.unsavedFile(), std::nullopt);
}

TEST_F(DataFolderTest, AReadNeverCreatesAFile) {
    EXPECT_EQ(m_data.ReadIni("RDS", "PS", "Datenset1.INI"), "");
    EXPECT_TRUE(fs::is_empty(m_folder.data()));
}

TEST_F(DataFolderTest, AnEmptyValueReadsLikeAMissingKey) {
    m_folder.write("Datenset1.INI", "[RDS]\r\nPS=\r\n");
    EXPECT_EQ(m_data.ReadIni("RDS", "PS", "Datenset1.INI"), "");
    EXPECT_EQ(m_data.ReadIni("RDS", "PI", "Datenset1.INI"), "");
}

TEST_F(DataFolderTest, AValueOf300CharactersReadsBackAsItsFirst254) {
    const std::string value(300, 'x');
    m_data.WriteIni("RDS", "RTA", value, "Datenset1.INI");
    EXPECT_EQ(m_folder.read("Datenset1.INI"), "[RDS]\r\nRTA=" + value + "\r\n");
    EXPECT_EQ(m_data.ReadIni("RDS", "RTA", "Datenset1.INI"), std::string(254, 'x'));
}

TEST_F(DataFolderTest, TheAriAreaWrittenByTheWindowIsNotTheOneReadAtStart) {
    m_data.WriteIni("FM", "ARI-BK", "3", kGeneralSettings);
    EXPECT_EQ(m_data.ReadIni("FM", "ARI_BK", kGeneralSettings), "");
}

TEST_F(DataFolderTest, WritesGoToTheCurrentDataSetWhileTheGeneratorIsReadFromDataSetOne) {
    m_folder.write("Datenset1.INI", "[VRN]\r\nHF_Frequenz=87.6\r\n");
    m_folder.write("Datenset3.INI", "[VRN]\r\nHF_Frequenz=100\r\n");
    ProgramState state;
    state.CurrentDataSet = "3";
    m_data.WriteIni("RDS", "PS", "RADIO", dataSetFile(state.CurrentDataSet));
    EXPECT_EQ(m_folder.read("Datenset3.INI"), "[VRN]\r\nHF_Frequenz=100\r\n[RDS]\r\nPS=RADIO\r\n");
    EXPECT_EQ(m_folder.read("Datenset1.INI"), "[VRN]\r\nHF_Frequenz=87.6\r\n");
    EXPECT_EQ(m_data.ReadIni("VRN", "HF_Frequenz", "Datenset1.ini"), "87.6");
}

TEST_F(DataFolderTest, TheReportStandsUntilAWriteToThatFileSucceeds) {
    int changes = 0;
    m_data.onUnsavedFileChanged([&] { ++changes; });
    const fs::path blocked = m_folder.data() / "RDS_Allg.INI";
    fs::create_directory(blocked);
    m_data.WriteIni("BUS", "INTERFACE", "IEC", "RDS_Allg.INI");
    m_data.WriteIni("BUS", "INTERFACE", "IEC", "RDS_Allg.INI");
    EXPECT_EQ(changes, 1);

    m_data.WriteIni("RDS", "PS", "RADIO", "Datenset1.INI");
    EXPECT_EQ(m_data.unsavedFile(), "RDS_Allg.INI") << "another file's success does not count";
    EXPECT_EQ(changes, 1);

    fs::remove(blocked);
    m_data.WriteIni("BUS", "INTERFACE", "IEC", "RDS_ALLG.ini");
    EXPECT_EQ(m_data.unsavedFile(), std::nullopt);
    EXPECT_EQ(changes, 2);
}

TEST_F(DataFolderTest, WithSeveralUnsavedFilesTheOneThatFailedLastIsNamed) {
    fs::create_directory(m_folder.data() / "RDS_Allg.INI");
    fs::create_directory(m_folder.data() / "Datenset1.INI");
    m_data.WriteIni("BUS", "INTERFACE", "IEC", "RDS_Allg.INI");
    m_data.WriteIni("RDS", "PS", "RADIO", "Datenset1.INI");
    EXPECT_EQ(m_data.unsavedFile(), "Datenset1.INI");
    fs::remove(m_folder.data() / "Datenset1.INI");
    m_data.WriteIni("RDS", "PS", "RADIO", "Datenset1.INI");
    EXPECT_EQ(m_data.unsavedFile(), "RDS_Allg.INI");
}

TEST_F(DataFolderTest, GarbageNulBytesAndAMegabyteLongLineAreReadAndKept) {
    const std::string garbage = std::string("\xFE\0\xFF[\0\r\n=\n]\r", 10) + std::string(1 << 20, '[') + "\n";
    m_folder.write("Datenset1.INI", garbage);
    EXPECT_EQ(m_data.ReadIni("RDS", "PS", "Datenset1.INI"), "");
    m_data.WriteIni("RDS", "PS", "RADIO", "Datenset1.INI");
    EXPECT_EQ(m_folder.read("Datenset1.INI"), garbage + "[RDS]\r\nPS=RADIO\r\n");
    EXPECT_EQ(m_data.ReadIni("RDS", "PS", "Datenset1.INI"), "RADIO");
}

}  // namespace
}  // namespace kdx
