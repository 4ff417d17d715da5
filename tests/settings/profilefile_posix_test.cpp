#include <gtest/gtest.h>

#include "settings/profilefile.h"
#include "support/tempfolder.h"
#include "support/unprivileged.h"

namespace kdx {
namespace {

TEST(ReadFileTest, GivesNothingForADevice) {
    EXPECT_EQ(readFile("/dev/zero"), std::nullopt);
}

TEST(ReadToChangeTest, TakesALinkThatLeadsNowhereForAFileYetToBeMade) {
    const test::TempFolder folder;
    std::filesystem::create_symlink("missing.ini", folder.data() / "a.ini");
    EXPECT_EQ(readToChange(folder.data() / "a.ini"), "");
}

TEST(ReadToChangeTest, GivesNothingForWhatWouldBeLost) {
    const test::TempFolder folder;
    folder.write("a.ini", "PS=A");
    std::filesystem::permissions(folder.data() / "a.ini", std::filesystem::perms::none);
    std::filesystem::permissions(folder.data(), std::filesystem::perms::all);
    const test::Unprivileged user;
    EXPECT_EQ(readToChange(folder.data() / "a.ini"), std::nullopt);
    EXPECT_EQ(readToChange(folder.data()), std::nullopt);
    EXPECT_EQ(readToChange("/dev/zero"), std::nullopt);
}

}  // namespace
}  // namespace kdx
