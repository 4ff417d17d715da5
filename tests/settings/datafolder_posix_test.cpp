#include <gtest/gtest.h>
#include <sys/stat.h>

#include "settings/datafoldertest.h"
#include "settings/ownfiles.h"
#include "support/unprivileged.h"

namespace kdx {
namespace {

namespace fs = std::filesystem;

TEST_F(DataFolderTest, AFileThatCannotBeReadIsNeverReplaced) {
    if (geteuid() != 0) GTEST_SKIP() << "only the administrator can play two users";
    m_folder.write("RDS_Allg.INI", "[BUS]\r\nINTERFACE=IEC\r\n");
    ASSERT_EQ(::chmod((m_folder.data() / "RDS_Allg.INI").c_str(), 0622), 0);
    ASSERT_EQ(::chmod(m_folder.data().c_str(), 0777), 0);
    {
        const test::Unprivileged user;
        EXPECT_EQ(m_data.ReadIni("BUS", "INTERFACE", kGeneralSettings), "");
        m_data.WriteIni("BUS", "INTERFACE", "TCPIP", kGeneralSettings);
        EXPECT_EQ(m_data.unsavedFile(), "RDS_Allg.INI");
    }
    EXPECT_EQ(m_folder.read("RDS_Allg.INI"), "[BUS]\r\nINTERFACE=IEC\r\n");
}

TEST_F(DataFolderTest, AReadOnlyFolderKeepsItsFilesAndIsReported) {
    m_folder.write("RDS_Allg.INI", "[BUS]\r\nINTERFACE=IEC\r\n");
    ASSERT_EQ(::chmod((m_folder.data() / "RDS_Allg.INI").c_str(), 0666), 0);
    ASSERT_EQ(::chmod(m_folder.data().c_str(), 0555), 0);
    {
        const test::Unprivileged user;
        m_data.WriteIni("BUS", "INTERFACE", "TCPIP", kGeneralSettings);
        EXPECT_EQ(m_data.unsavedFile(), "RDS_Allg.INI");
        EXPECT_EQ(DataFolder(m_folder.path()).ReadIni("BUS", "INTERFACE", kGeneralSettings), "IEC");
    }
    EXPECT_EQ(m_folder.read("RDS_Allg.INI"), "[BUS]\r\nINTERFACE=IEC\r\n");
}

TEST_F(DataFolderTest, AValueThatStandsThereAlreadyIsNotWrittenAgain) {
    m_data.WriteIni("RDS", "PS", "RADIO", "Datenset1.INI");
    struct stat before {};
    struct stat after {};
    ASSERT_EQ(::stat(m_data.file("Datenset1.INI").c_str(), &before), 0);
    m_data.WriteIni("RDS", "PS", "RADIO", "Datenset1.INI");
    ASSERT_EQ(::stat(m_data.file("Datenset1.INI").c_str(), &after), 0);
    EXPECT_EQ(before.st_ino, after.st_ino);
}

TEST_F(DataFolderTest, ALinkedFileIsWrittenWhereItIs) {
    const fs::path elsewhere = m_folder.path() / "shared.ini";
    fs::create_symlink(elsewhere, m_folder.data() / "Datenset1.INI");
    m_data.WriteIni("RDS", "PS", "RADIO", "Datenset1.INI");
    EXPECT_TRUE(fs::is_regular_file(elsewhere));
    EXPECT_TRUE(fs::is_symlink(m_folder.data() / "Datenset1.INI"));
    EXPECT_EQ(m_data.ReadIni("RDS", "PS", "datenset1.ini"), "RADIO");
}

TEST_F(DataFolderTest, AnOwnFileIsOneByALinkToo) {
    m_folder.write("RDS_log.txt", "1\n");
    fs::create_symlink(m_folder.data() / "RDS_log.txt", m_folder.path() / "to-the-log.txt");
    fs::create_directory_symlink(m_folder.data(), m_folder.path() / "to-the-folder");
    m_folder.write("../elsewhere.txt", "2\n");
    fs::create_symlink(m_folder.path() / "elsewhere.txt", m_folder.data() / "Event.txt");
    EXPECT_TRUE(isOwnFile(m_data, m_folder.path() / "to-the-log.txt"));
    EXPECT_TRUE(isOwnFile(m_data, m_folder.path() / "to-the-folder" / "Datenset1.INI"));
    EXPECT_TRUE(isOwnFile(m_data, m_folder.path() / "elsewhere.txt")) << "an own file is a link to it";
}

}  // namespace
}  // namespace kdx
