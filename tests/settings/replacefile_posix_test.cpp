// What replacing a file promises where owners, links and devices are known.
#include <gtest/gtest.h>
#include <sys/stat.h>

#include "settings/profilefile.h"
#include "support/fulldisk.h"
#include "support/tempfolder.h"
#include "support/unprivileged.h"

namespace kdx {
namespace {

namespace fs = std::filesystem;

constexpr uid_t kSomeUser = 12345;
constexpr gid_t kSomeGroup = 23456;

class ReplaceFilePosixTest : public ::testing::Test {
protected:
    [[nodiscard]] fs::path path(const char* name) const { return m_folder.data() / name; }
    [[nodiscard]] struct stat statusOf(const char* name) const {
        struct stat status {};
        EXPECT_EQ(::stat(path(name).c_str(), &status), 0);
        return status;
    }
    [[nodiscard]] std::ptrdiff_t entries() const {
        return std::distance(fs::directory_iterator(m_folder.data()), fs::directory_iterator());
    }
    test::TempFolder m_folder;
};

TEST_F(ReplaceFilePosixTest, KeepsTheOwnerAndEveryBitOfTheMode) {
    if (geteuid() != 0) GTEST_SKIP() << "only the administrator can give a file away";
    m_folder.write("a.ini", "old");
    ASSERT_EQ(::chown(path("a.ini").c_str(), kSomeUser, kSomeGroup), 0);
    ASSERT_EQ(::chmod(path("a.ini").c_str(), 02664), 0);
    EXPECT_TRUE(replaceFile(path("a.ini"), "new"));
    const struct stat status = statusOf("a.ini");
    EXPECT_EQ(status.st_uid, kSomeUser);
    EXPECT_EQ(status.st_gid, kSomeGroup);
    EXPECT_EQ(status.st_mode & 07777, 02664U);
    EXPECT_EQ(m_folder.read("a.ini"), "new");
}

TEST_F(ReplaceFilePosixTest, SavesAnotherUsersFileThatEverybodyMayWrite) {
    if (geteuid() != 0) GTEST_SKIP() << "only the administrator can play two users";
    m_folder.write("a.ini", "old");
    ASSERT_EQ(::chmod(path("a.ini").c_str(), 0666), 0);
    ASSERT_EQ(::chmod(m_folder.data().c_str(), 0777), 0);
    {
        const test::Unprivileged user;
        EXPECT_TRUE(replaceFile(path("a.ini"), "new"));
    }
    EXPECT_EQ(m_folder.read("a.ini"), "new");
    EXPECT_EQ(statusOf("a.ini").st_mode & 07777, 0666U);
}

TEST_F(ReplaceFilePosixTest, LeavesAFileThatTheUserMayNotWriteAsItIs) {
    if (geteuid() != 0) GTEST_SKIP() << "only the administrator can play two users";
    m_folder.write("a.ini", "old");
    ASSERT_EQ(::chmod(path("a.ini").c_str(), 0644), 0);
    ASSERT_EQ(::chmod(m_folder.data().c_str(), 0777), 0);
    {
        const test::Unprivileged user;
        EXPECT_FALSE(replaceFile(path("a.ini"), "new"));
    }
    EXPECT_EQ(m_folder.read("a.ini"), "old");
    EXPECT_EQ(entries(), 1);
}

TEST_F(ReplaceFilePosixTest, ANewFileGetsTheModeThatTheUsersMaskLeaves) {
    const mode_t before = ::umask(027);
    EXPECT_TRUE(replaceFile(path("a.ini"), "new"));
    ::umask(before);
    EXPECT_EQ(statusOf("a.ini").st_mode & 07777, 0640U);
}

TEST_F(ReplaceFilePosixTest, FailsInAReadOnlyFolder) {
    m_folder.write("a.ini", "old");
    ASSERT_EQ(::chmod(path("a.ini").c_str(), 0666), 0);
    ASSERT_EQ(::chmod(m_folder.data().c_str(), 0555), 0);
    {
        const test::Unprivileged user;
        EXPECT_FALSE(replaceFile(path("a.ini"), "new"));
        EXPECT_FALSE(replaceFile(path("b.ini"), "new"));
    }
    EXPECT_EQ(m_folder.read("a.ini"), "old");
    EXPECT_EQ(entries(), 1);
}

TEST_F(ReplaceFilePosixTest, NeverReplacesADevice) {
    fs::create_symlink("/dev/full", path("a.ini"));
    EXPECT_FALSE(replaceFile(path("a.ini"), "new"));
    EXPECT_TRUE(fs::is_character_file("/dev/full"));
}

TEST_F(ReplaceFilePosixTest, ARelativeNameMeansTheCurrentFolder) {
    const fs::path before = fs::current_path();
    fs::current_path(m_folder.data());
    EXPECT_TRUE(replaceFile("a.ini", "new"));
    fs::current_path(before);
    EXPECT_EQ(m_folder.read("a.ini"), "new");
}

TEST_F(ReplaceFilePosixTest, KeepsTheMode) {
    m_folder.write("a.ini", "old");
    const auto mode = fs::perms::owner_read | fs::perms::owner_write | fs::perms::group_write | fs::perms::others_read;
    fs::permissions(path("a.ini"), mode);
    EXPECT_TRUE(replaceFile(path("a.ini"), "new"));
    EXPECT_EQ(fs::status(path("a.ini")).permissions(), mode);
}

TEST_F(ReplaceFilePosixTest, FollowsLinksAndLeavesThemInPlace) {
    m_folder.write("real.ini", "old");
    fs::create_symlink("real.ini", path("relative.ini"));
    fs::create_symlink(path("relative.ini"), path("absolute.ini"));
    EXPECT_TRUE(replaceFile(path("absolute.ini"), "new"));
    EXPECT_EQ(m_folder.read("real.ini"), "new");
    EXPECT_TRUE(fs::is_symlink(path("relative.ini")));
    EXPECT_TRUE(fs::is_symlink(path("absolute.ini")));
    EXPECT_EQ(entries(), 3);
}

TEST_F(ReplaceFilePosixTest, CreatesTheFileThatALinkIsWaitingFor) {
    fs::create_symlink("real.ini", path("link.ini"));
    EXPECT_TRUE(replaceFile(path("link.ini"), "new"));
    EXPECT_EQ(m_folder.read("real.ini"), "new");
    EXPECT_TRUE(fs::is_symlink(path("link.ini")));
}

TEST_F(ReplaceFilePosixTest, FailsOnALinkIntoAMissingFolder) {
    fs::create_symlink("missing/real.ini", path("link.ini"));
    EXPECT_FALSE(replaceFile(path("link.ini"), "new"));
    EXPECT_TRUE(fs::is_symlink(path("link.ini")));
    EXPECT_EQ(entries(), 1);
}

TEST_F(ReplaceFilePosixTest, FailsOnLinksThatRunInACircle) {
    fs::create_symlink("b.ini", path("a.ini"));
    fs::create_symlink("a.ini", path("b.ini"));
    EXPECT_FALSE(replaceFile(path("a.ini"), "new"));
    EXPECT_EQ(entries(), 2);
}

TEST_F(ReplaceFilePosixTest, AFullDiskLeavesTheOldFileAndNothingElse) {
    m_folder.write("a.ini", "old");
    {
        const test::FullDisk disk(4096);  // the write beside the file gets stuck half-way
        EXPECT_FALSE(replaceFile(path("a.ini"), std::string(10000, 'x')));
    }
    EXPECT_EQ(m_folder.read("a.ini"), "old");
    EXPECT_EQ(entries(), 1);
}

TEST_F(ReplaceFilePosixTest, WritesBesideTheFileSoThatAnOpenReaderKeepsTheOldContent) {
    m_folder.write("a.ini", "old");
    std::ifstream reader(path("a.ini"), std::ios::binary);
    EXPECT_TRUE(replaceFile(path("a.ini"), "new"));
    std::string content;
    reader >> content;
    EXPECT_EQ(content, "old");
}

}  // namespace
}  // namespace kdx
