// Values that could not be written at their time, and files that cannot be read.
#include <gtest/gtest.h>

#include "settings/datafolder.h"
#include "support/tempfolder.h"

namespace kdx {
namespace {

namespace fs = std::filesystem;
using namespace std::string_literals;

constexpr const char* kFile = "Datenset1.INI";
constexpr const char* kBefore = "[RDS]\r\nPS=OLD\r\nPI=D3C0\r\n";

class UnsavedTest : public ::testing::Test {
protected:
    UnsavedTest() {
        m_folder.write(kFile, kBefore);
        m_data.onUnsavedFileChanged([this] { ++m_notices; });
    }
    /// While it is marked read-only nothing can be written to the file, whoever runs the test.
    void lock(const char* name = kFile) const { fs::permissions(m_folder.data() / name, fs::perms::owner_read); }
    void unlock(const char* name = kFile) const {
        fs::permissions(m_folder.data() / name, fs::perms::owner_read | fs::perms::owner_write);
    }
    [[nodiscard]] std::string read(const char* key) const { return m_data.ReadIni("RDS", key, kFile); }
    void write(const char* key, std::string_view value) { m_data.WriteIni("RDS", key, value, kFile); }

    test::TempFolder m_folder;
    DataFolder m_data{m_folder.path()};
    int m_notices = 0;
};

TEST_F(UnsavedTest, AValueThatCouldNotBeWrittenGoesWithTheNextWriteToItsFile) {
    lock();
    write("PS", "NEW");
    EXPECT_EQ(m_folder.read(kFile), kBefore);
    EXPECT_EQ(m_data.unsavedFile(), kFile);
    unlock();
    write("PI", "D3C1");
    EXPECT_EQ(m_folder.read(kFile), "[RDS]\r\nPS=NEW\r\nPI=D3C1\r\n");
    EXPECT_EQ(m_data.unsavedFile(), std::nullopt);
    EXPECT_EQ(m_notices, 2);
}

TEST_F(UnsavedTest, ItGoesWithAnotherTryToo) {
    lock();
    write("PS", "NEW");
    write("MS", "M");
    m_data.retryUnsaved();
    EXPECT_EQ(m_data.unsavedFile(), kFile);
    EXPECT_EQ(m_notices, 1);
    unlock();
    m_data.retryUnsaved();
    EXPECT_EQ(m_folder.read(kFile), "[RDS]\r\nPS=NEW\r\nPI=D3C0\r\nMS=M\r\n");
    EXPECT_EQ(m_data.unsavedFile(), std::nullopt);
    EXPECT_EQ(m_notices, 2);
}

TEST_F(UnsavedTest, AReadGivesItMeanwhileByTheRulesOfReading) {
    lock();
    write("PS", "NEW");
    write("RTA", " \"" + std::string(300, 'x') + "\" ");
    EXPECT_EQ(read("PS"), "NEW");
    EXPECT_EQ(m_data.ReadIni("rds", " ps ", "DATENSET1.ini"), "NEW");
    EXPECT_EQ(read("RTA"), std::string(254, 'x'));
    EXPECT_EQ(read("PI"), "D3C0") << "the others stay";
    write("PS", "");
    EXPECT_EQ(read("PS"), "");
}

TEST_F(UnsavedTest, ReadsMeanwhileCopyTheFileOnceOnly) {
    lock();
    write("PS", "NEW");
    const auto first = m_data.profile(kFile);
    EXPECT_EQ(m_data.profile(kFile), first);
    write("PS", "NEWER");
    EXPECT_EQ(m_data.profile(kFile)->value("RDS", "PS"), "NEWER");
    EXPECT_EQ(first->value("RDS", "PS"), "NEW") << "what was handed out stays as it is";
}

TEST_F(UnsavedTest, OfSeveralValuesOfAKeyTheLastIsKept) {
    lock();
    write("PS", "FIRST");
    m_data.WriteIni("rds", "ps", "SECOND", "datenset1.ini");
    EXPECT_EQ(read("PS"), "SECOND");
    unlock();
    m_data.retryUnsaved();
    EXPECT_EQ(m_folder.read(kFile), "[RDS]\r\nPS=SECOND\r\nPI=D3C0\r\n");
}

TEST_F(UnsavedTest, WhatAnotherProgramWroteMeanwhileStays) {
    lock();
    write("PS", "NEW");
    unlock();
    m_folder.write(kFile, "[RDS]\r\nPS=THEIRS\r\nPI=1234\r\n[FM]\r\nARI=1\r\n");
    EXPECT_EQ(read("PI"), "1234");
    m_data.retryUnsaved();
    EXPECT_EQ(m_folder.read(kFile), "[RDS]\r\nPS=NEW\r\nPI=1234\r\n[FM]\r\nARI=1\r\n");
}

TEST_F(UnsavedTest, TheNoticeStandsUntilNothingIsLeft) {
    m_folder.write(kGeneralSettings, "");
    lock();
    lock(kGeneralSettings);
    write("PS", "NEW");
    m_data.WriteIni("BUS", "INTERFACE", "IEC", kGeneralSettings);
    EXPECT_EQ(m_data.unsavedFile(), kGeneralSettings);
    unlock(kGeneralSettings);
    m_data.retryUnsaved();
    EXPECT_EQ(m_data.unsavedFile(), kFile);
    unlock();
    m_data.retryUnsaved();
    EXPECT_EQ(m_data.unsavedFile(), std::nullopt);
    EXPECT_EQ(m_folder.read(kGeneralSettings), "[BUS]\r\nINTERFACE=IEC\r\n");
    EXPECT_EQ(read("PS"), "NEW");
}

TEST_F(UnsavedTest, AFolderThatComesBackGetsEverything) {
    fs::rename(m_folder.data(), m_folder.path() / "away");
    write("PS", "NEW");
    EXPECT_EQ(read("PS"), "NEW");
    EXPECT_EQ(m_data.unsavedFile(), kFile);
    fs::rename(m_folder.path() / "away", m_folder.data());
    m_data.retryUnsaved();
    EXPECT_EQ(m_folder.read(kFile), "[RDS]\r\nPS=NEW\r\nPI=D3C0\r\n");
}

TEST_F(UnsavedTest, AFolderInTheFilesPlaceReadsAsNothingAndGivesTheValueBackWhenItGoes) {
    const fs::path file = m_folder.data() / kGeneralSettings;
    fs::create_directory(file);
    m_data.WriteIni("BUS", "INTERFACE", "IEC", kGeneralSettings);
    EXPECT_EQ(m_data.ReadIni("BUS", "INTERFACE", kGeneralSettings), "");
    EXPECT_EQ(m_data.unsavedFile(), kGeneralSettings);
    EXPECT_TRUE(fs::is_directory(file));
    fs::remove(file);
    EXPECT_EQ(m_data.ReadIni("BUS", "INTERFACE", kGeneralSettings), "IEC") << "kept meanwhile";
    m_data.retryUnsaved();
    EXPECT_EQ(m_data.unsavedFile(), std::nullopt);
    EXPECT_EQ(m_folder.read(kGeneralSettings), "[BUS]\r\nINTERFACE=IEC\r\n");
}

TEST_F(UnsavedTest, AFileInUtf16IsToldAndLeftAlone) {
    for (const std::string& utf16 : {"\xFF\xFE[\0R\0D\0S\0]\0\r\0\n\0"s, "\xFE\xFF\0[\0R\0D\0S\0]\0\r\0\n"s}) {
        m_folder.write(kFile, utf16);
        m_notices = 0;
        EXPECT_EQ(read("PS"), "");
        EXPECT_EQ(m_data.unreadableFile(), kFile);
        EXPECT_EQ(m_data.unsavedFile(), std::nullopt);
        EXPECT_EQ(m_notices, 1);
        write("PS", "NEW");
        m_data.retryUnsaved();
        EXPECT_EQ(m_folder.read(kFile), utf16);
        EXPECT_EQ(m_data.unsavedFile(), kFile);
        EXPECT_EQ(m_notices, 2);

        m_folder.write(kFile, kBefore);  // saved anew by its editor
        m_data.retryUnsaved();
        EXPECT_EQ(m_data.unreadableFile(), std::nullopt);
        EXPECT_EQ(m_data.unsavedFile(), std::nullopt);
        EXPECT_EQ(read("PS"), "NEW");
        EXPECT_EQ(m_notices, 3);
    }
}

TEST_F(UnsavedTest, AFolderInAFilesPlaceIsUnreadable) {
    fs::create_directory(m_folder.data() / "a.ini");
    EXPECT_EQ(m_data.ReadIni("M", "a", "a.ini"), "");
    EXPECT_EQ(m_data.unreadableFile(), "a.ini");
    fs::remove(m_folder.data() / "a.ini");
    EXPECT_EQ(m_data.ReadIni("M", "a", "a.ini"), "");
    EXPECT_EQ(m_data.unreadableFile(), std::nullopt) << "a missing file is no fault";
}

TEST_F(UnsavedTest, AFileThatCouldNotBeWrittenHidesNoOtherThatCannotBeRead) {
    for (const char* name : {"a.ini", "b.ini"}) fs::create_directory(m_folder.data() / name);
    EXPECT_EQ(m_data.ReadIni("M", "a", "a.ini"), "");
    m_data.WriteIni("M", "a", "1", "b.ini");
    EXPECT_EQ(m_data.unsavedFile(), "b.ini");
    EXPECT_EQ(m_data.unreadableFile(), "a.ini");
}

TEST_F(UnsavedTest, FilesThatCanBeReadOrAreMissingAreNotTold) {
    EXPECT_EQ(read("PS"), "OLD");
    EXPECT_EQ(m_data.ReadIni("BUS", "INTERFACE", kGeneralSettings), "");
    EXPECT_EQ(m_data.unreadableFile(), std::nullopt);
    EXPECT_EQ(m_notices, 0);
}

}  // namespace
}  // namespace kdx
