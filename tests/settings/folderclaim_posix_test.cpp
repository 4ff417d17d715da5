// Claims of programs that are killed, through links and without rights.
#include <gtest/gtest.h>
#include <sys/wait.h>

#include <array>
#include <csignal>

#include "settings/folderlock.h"
#include "support/tempfolder.h"
#include "support/unprivileged.h"

namespace kdx {
namespace {

namespace fs = std::filesystem;

/// Another program that has claimed the folder, until it is killed.
class OtherProgram {
public:
    explicit OtherProgram(const fs::path& folder) {
        std::array<int, 2> ready{};
        EXPECT_EQ(::pipe(ready.data()), 0);
        m_process = fork();
        if (m_process == 0) {
            const FolderClaim claim(folder);
            (void)!::write(ready[1], "x", 1);
            ::pause();
            _exit(0);
        }
        char got = 0;
        EXPECT_EQ(::read(ready[0], &got, 1), 1);
        ::close(ready[0]);
        ::close(ready[1]);
    }
    ~OtherProgram() { kill(); }
    OtherProgram(const OtherProgram&) = delete;
    OtherProgram& operator=(const OtherProgram&) = delete;
    void kill() {
        if (m_process <= 0) return;
        ::kill(m_process, SIGKILL);
        ::waitpid(m_process, nullptr, 0);
        m_process = 0;
    }

private:
    pid_t m_process = 0;
};

TEST(FolderClaimTest, AnotherLivingProgramIsNoticedAndACrashedOneIsNot) {
    const test::TempFolder folder;
    OtherProgram other(folder.data());
    const FolderClaim claim(folder.data());
    EXPECT_TRUE(claim.isShared());
    EXPECT_TRUE(claim.isShared()) << "however often one looks";
    other.kill();
    EXPECT_FALSE(claim.isShared());
    const OtherProgram later(folder.data());
    EXPECT_TRUE(claim.isShared()) << "and one that came later";
    EXPECT_TRUE(fs::is_empty(folder.data()));
}

TEST(FolderClaimTest, AFolderUnderAnotherNameIsTheSame) {
    const test::TempFolder folder;
    fs::create_directory_symlink(folder.data(), folder.path() / "link");
    const OtherProgram other(folder.path() / "link");
    EXPECT_TRUE(FolderClaim(folder.data()).isShared());
}

TEST(FolderClaimTest, OtherFoldersDoNotCount) {
    const test::TempFolder folder;
    const test::TempFolder elsewhere;
    const OtherProgram other(elsewhere.data());
    EXPECT_FALSE(FolderClaim(folder.data()).isShared());
}

TEST(FolderClaimTest, AReadOnlyFolderCanBeClaimed) {
    const test::TempFolder folder;
    fs::permissions(folder.data(),
                    fs::perms::owner_read | fs::perms::owner_exec | fs::perms::others_read | fs::perms::others_exec);
    const OtherProgram other(folder.data());
    const test::Unprivileged user;
    EXPECT_TRUE(FolderClaim(folder.data()).isShared());
}

}  // namespace
}  // namespace kdx
