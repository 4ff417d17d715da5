#include <gtest/gtest.h>

#include <filesystem>
#include <optional>

#include "settings/datafolder.h"
#include "settings/folderlock.h"
#include "support/tempfolder.h"

namespace kdx {
namespace {

namespace fs = std::filesystem;

TEST(FolderClaimTest, AloneTheFolderIsNotShared) {
    const test::TempFolder folder;
    const FolderClaim claim(folder.data());
    EXPECT_FALSE(claim.isShared());
    EXPECT_TRUE(fs::is_empty(folder.data()));
}

TEST(FolderClaimTest, AClaimOutlivesWritesToTheFolder) {
    const test::TempFolder folder;
    const FolderClaim claim(folder.data());
    DataFolder data(folder.path());
    data.WriteIni("M", "a", "1", "a.ini");
    EXPECT_EQ(data.unsavedFile(), std::nullopt) << "the own claim is in nobody's way";
    const FolderClaim second(folder.data());
    EXPECT_TRUE(second.isShared());
}

TEST(FolderClaimTest, AMissingFolderIsNotShared) {
    EXPECT_FALSE(FolderClaim("/nowhere/at/all").isShared());
}

TEST(FolderClaimTest, EveryOtherClaimCountsAsLongAsItLives) {
    const test::TempFolder folder;
    std::optional<FolderClaim> first(folder.data());
    std::optional<FolderClaim> second(folder.data());
    const FolderClaim third(folder.data());
    EXPECT_TRUE(first->isShared() && second->isShared() && third.isShared());
    first.reset();
    EXPECT_TRUE(third.isShared());
    second.reset();
    EXPECT_FALSE(third.isShared());
    first.emplace(folder.data());
    EXPECT_TRUE(third.isShared()) << "and one that came later";
}

TEST(FolderClaimTest, AnotherFolderIsNobodyElses) {
    const test::TempFolder folder;
    const test::TempFolder elsewhere;
    const FolderClaim other(elsewhere.data());
    EXPECT_FALSE(FolderClaim(folder.data()).isShared());
}

}  // namespace
}  // namespace kdx
