// What locking a folder promises on every system.
#include "settings/folderlock.h"

#include <gtest/gtest.h>
#include <sys/wait.h>

#include <array>
#include <csignal>
#include <string>

#include "settings/datafolder.h"
#include "support/tempfolder.h"
#include "support/unprivileged.h"

namespace kdx {
namespace {

namespace fs = std::filesystem;

class FolderLockTest : public ::testing::Test {
protected:
    /// Another program that does the work.
    template <typename Work>
    static pid_t run(Work work) {
        const pid_t child = fork();
        if (child == 0) {
            work();
            _exit(0);
        }
        EXPECT_GT(child, 0);
        return child;
    }
    static void await(pid_t child) {
        int status = 0;
        ASSERT_EQ(::waitpid(child, &status, 0), child);
        EXPECT_EQ(status, 0);
    }
    test::TempFolder m_folder;
};

TEST_F(FolderLockTest, RunsTheWorkAndLeavesNothingBehind) {
    bool run = false;
    EXPECT_TRUE(underFolderLock(m_folder.data(), [&] { run = true; }));
    EXPECT_TRUE(run);
    EXPECT_TRUE(fs::is_empty(m_folder.data()));
}

TEST_F(FolderLockTest, RunsTheWorkWhereNothingCanBeLocked) {
    bool run = false;
    EXPECT_TRUE(underFolderLock(m_folder.path() / "missing", [&] { run = true; }));
    EXPECT_TRUE(run);
    EXPECT_FALSE(fs::exists(m_folder.path() / "missing"));
    fs::permissions(m_folder.data(), fs::perms::none);
    const test::Unprivileged user;
    run = false;
    EXPECT_TRUE(underFolderLock(m_folder.data(), [&] { run = true; }));
    EXPECT_TRUE(run);
}

TEST_F(FolderLockTest, ProgramsThatWriteAtTheSameTimeLoseNothing) {
    constexpr int kWrites = 60;
    const std::array<std::string, 3> names = {"a", "b", "c"};
    std::array<pid_t, 3> children{};
    for (std::size_t i = 0; i < names.size(); ++i) {
        children.at(i) = run([&] {
            DataFolder data(m_folder.path());
            for (int write = 0; write < kWrites; ++write) {
                data.WriteIni("M", names.at(i) + std::to_string(write), std::to_string(write), "a.ini");
            }
            if (data.unsavedFile()) _exit(1);
        });
    }
    for (const pid_t child : children) await(child);
    const DataFolder data(m_folder.path());
    int lost = 0;
    for (const std::string& name : names) {
        for (int write = 0; write < kWrites; ++write) {
            const std::string text = std::to_string(write);
            if (data.ReadIni("M", name + text, "a.ini") != text) ++lost;
        }
    }
    EXPECT_EQ(lost, 0);
    EXPECT_EQ(std::distance(fs::directory_iterator(m_folder.data()), fs::directory_iterator()), 1);
}

TEST_F(FolderLockTest, AProgramThatKeepsTheLockMakesAWriteWaitForItsNextTry) {
    std::array<int, 2> ready{};
    ASSERT_EQ(::pipe(ready.data()), 0);
    const pid_t child = run([&] {
        (void)underFolderLock(m_folder.data(), [&] {
            (void)!::write(ready[1], "x", 1);
            ::pause();
        });
    });
    char got = 0;
    ASSERT_EQ(::read(ready[0], &got, 1), 1);
    DataFolder data(m_folder.path());
    data.WriteIni("M", "a", "1", "a.ini");
    EXPECT_EQ(data.unsavedFile(), "a.ini");
    EXPECT_EQ(data.ReadIni("M", "a", "a.ini"), "1");
    EXPECT_EQ(m_folder.read("a.ini"), "");

    ::kill(child, SIGKILL);
    ::waitpid(child, nullptr, 0);
    ::close(ready[0]);
    ::close(ready[1]);
    // What a killed program leaves of a lock counts no longer; on some systems only after a while.
    std::error_code none;
    const fs::path mark = m_folder.data() / ".kdx-rds-lock";
    fs::last_write_time(mark, fs::file_time_type::clock::now() - std::chrono::hours(1), none);
    data.retryUnsaved();
    EXPECT_EQ(data.unsavedFile(), std::nullopt);
    EXPECT_EQ(m_folder.read("a.ini"), "[M]\r\na=1\r\n");
    EXPECT_FALSE(fs::exists(mark));
}

}  // namespace
}  // namespace kdx
