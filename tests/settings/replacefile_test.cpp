// What replacing a file promises on every system.
#include <gtest/gtest.h>
#include <sys/resource.h>
#include <sys/wait.h>

#include <csignal>

#include "settings/profilefile.h"
#include "support/tempfolder.h"

namespace kdx {
namespace {

namespace fs = std::filesystem;

class ReplaceFileTest : public ::testing::Test {
protected:
    [[nodiscard]] fs::path path(const char* name) const { return m_folder.data() / name; }
    [[nodiscard]] std::ptrdiff_t entries() const {
        return std::distance(fs::directory_iterator(m_folder.data()), fs::directory_iterator());
    }
    test::TempFolder m_folder;
};

TEST_F(ReplaceFileTest, CreatesAFileThatIsMissing) {
    EXPECT_TRUE(replaceFile(path("a.ini"), "new"));
    EXPECT_EQ(m_folder.read("a.ini"), "new");
    EXPECT_EQ(entries(), 1);
}

TEST_F(ReplaceFileTest, ReplacesTheWholeContent) {
    m_folder.write("a.ini", "something much longer");
    EXPECT_TRUE(replaceFile(path("a.ini"), std::string("a\0\r\n", 4)));
    EXPECT_EQ(m_folder.read("a.ini"), std::string("a\0\r\n", 4));
    EXPECT_EQ(entries(), 1);
}

TEST_F(ReplaceFileTest, WritesBesideTheFileSoThatAnOpenReaderKeepsTheOldContent) {
    m_folder.write("a.ini", "old");
    std::ifstream reader(path("a.ini"), std::ios::binary);
    EXPECT_TRUE(replaceFile(path("a.ini"), "new"));
    std::string content;
    reader >> content;
    EXPECT_EQ(content, "old");
}

TEST_F(ReplaceFileTest, WritesMegabytes) {
    const std::string bytes(3 << 20, 'x');
    EXPECT_TRUE(replaceFile(path("a.ini"), bytes));
    EXPECT_EQ(m_folder.read("a.ini"), bytes);
}

TEST_F(ReplaceFileTest, KeepsTheMode) {
    m_folder.write("a.ini", "old");
    const auto mode = fs::perms::owner_read | fs::perms::owner_write | fs::perms::group_write | fs::perms::others_read;
    fs::permissions(path("a.ini"), mode);
    EXPECT_TRUE(replaceFile(path("a.ini"), "new"));
    EXPECT_EQ(fs::status(path("a.ini")).permissions(), mode);
}

TEST_F(ReplaceFileTest, FollowsLinksAndLeavesThemInPlace) {
    m_folder.write("real.ini", "old");
    fs::create_symlink("real.ini", path("relative.ini"));
    fs::create_symlink(path("relative.ini"), path("absolute.ini"));
    EXPECT_TRUE(replaceFile(path("absolute.ini"), "new"));
    EXPECT_EQ(m_folder.read("real.ini"), "new");
    EXPECT_TRUE(fs::is_symlink(path("relative.ini")));
    EXPECT_TRUE(fs::is_symlink(path("absolute.ini")));
    EXPECT_EQ(entries(), 3);
}

TEST_F(ReplaceFileTest, CreatesTheFileThatALinkIsWaitingFor) {
    fs::create_symlink("real.ini", path("link.ini"));
    EXPECT_TRUE(replaceFile(path("link.ini"), "new"));
    EXPECT_EQ(m_folder.read("real.ini"), "new");
    EXPECT_TRUE(fs::is_symlink(path("link.ini")));
}

TEST_F(ReplaceFileTest, FailsOnALinkIntoAMissingFolder) {
    fs::create_symlink("missing/real.ini", path("link.ini"));
    EXPECT_FALSE(replaceFile(path("link.ini"), "new"));
    EXPECT_TRUE(fs::is_symlink(path("link.ini")));
    EXPECT_EQ(entries(), 1);
}

TEST_F(ReplaceFileTest, FailsOnLinksThatRunInACircle) {
    fs::create_symlink("b.ini", path("a.ini"));
    fs::create_symlink("a.ini", path("b.ini"));
    EXPECT_FALSE(replaceFile(path("a.ini"), "new"));
    EXPECT_EQ(entries(), 2);
}

TEST_F(ReplaceFileTest, FailsInAMissingFolderAndCreatesNone) {
    EXPECT_FALSE(replaceFile(path("missing") / "a.ini", "new"));
    EXPECT_EQ(entries(), 0);
}

TEST_F(ReplaceFileTest, FailsWhereAFolderIsInTheFilesPlace) {
    fs::create_directory(path("a.ini"));
    EXPECT_FALSE(replaceFile(path("a.ini"), "new"));
    EXPECT_TRUE(fs::is_directory(path("a.ini")));
    EXPECT_EQ(entries(), 1);
}

TEST_F(ReplaceFileTest, LeavesAFileMarkedReadOnlyAsItIsWhoeverRunsTheProgram) {
    m_folder.write("a.ini", "old");
    fs::permissions(path("a.ini"), fs::perms::owner_read | fs::perms::group_read);
    EXPECT_FALSE(replaceFile(path("a.ini"), "new"));
    EXPECT_EQ(m_folder.read("a.ini"), "old");
    EXPECT_EQ(entries(), 1);
}

TEST_F(ReplaceFileTest, AFullDiskLeavesTheOldFileAndNothingElse) {
    m_folder.write("a.ini", "old");
    const pid_t child = fork();
    ASSERT_GE(child, 0);
    if (child == 0) {
        // The disk takes 4096 more bytes: the write beside the file gets stuck half-way.
        std::signal(SIGXFSZ, SIG_IGN);
        const rlimit limit{4096, 4096};
        const bool limited = ::setrlimit(RLIMIT_FSIZE, &limit) == 0;
        const bool replaced = replaceFile(path("a.ini"), std::string(10000, 'x'));
        _exit(limited && !replaced ? 0 : 1);
    }
    int status = 0;
    ASSERT_EQ(::waitpid(child, &status, 0), child);
    EXPECT_TRUE(WIFEXITED(status));
    EXPECT_EQ(WEXITSTATUS(status), 0);
    EXPECT_EQ(m_folder.read("a.ini"), "old");
    EXPECT_EQ(entries(), 1);
}

}  // namespace
}  // namespace kdx
