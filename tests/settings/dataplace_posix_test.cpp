// Folders without rights, names that are no text, a full disk.
#include <gtest/gtest.h>

#include "settings/dataplacetest.h"
#include "support/fulldisk.h"
#include "support/unprivileged.h"

namespace kdx::test {
namespace {

namespace fs = std::filesystem;

TEST_F(DataPlaceTest, DataThatCannotBeWrittenBesideTheProgramAreNotUsed) {
    fs::create_directories(program / "Daten");
    fs::permissions(program / "Daten",
                    fs::perms::owner_read | fs::perms::owner_exec | fs::perms::others_read | fs::perms::others_exec);
    {
        const Unprivileged ordinary;
        EXPECT_EQ(choose(), user);
    }
    fs::permissions(program / "Daten", fs::perms::all);
    EXPECT_TRUE(fs::is_empty(program / "Daten"));
    EXPECT_EQ(get(user / "Daten" / "Datenset1.INI"), "[RDS]\r\nPS=SHIPPED\r\n");
}

TEST_F(DataPlaceTest, AShippedFileThatCannotBeReadIsNamed) {
    fs::permissions(shipped / "Daten" / "RDS_Allg.INI", fs::perms::none);
    const Unprivileged ordinary;
    EXPECT_EQ(choose(), user);
    EXPECT_NE(problem.find("RDS_Allg.INI"), std::string::npos) << problem;
    EXPECT_FALSE(fs::exists(user / "Daten" / "RDS_Allg.INI"));
}

TEST_F(DataPlaceTest, FolderNamesOfAnyBytesAreUsedAndShown) {
    places.user = base.path() / "B\xFCro\n";
    places.shipped = base.path() / "none\xE4";
    EXPECT_EQ(choose(), places.user);
    EXPECT_TRUE(fs::is_directory(places.user / "Daten"));
    EXPECT_NE(problem.find("/none\\xE4/Daten: "), std::string::npos) << problem;
    put(base.path() / "in\xFCthe\xFFway", "");
    places.user = base.path() / "in\xFCthe\xFFway";
    EXPECT_EQ(choose(), places.user);
    EXPECT_NE(problem.find("/in\\xFCthe\\xFFway/Daten: "), std::string::npos) << problem;
}

TEST_F(DataPlaceTest, ShippedFilesOfAnyNameAreCopied) {
    put(shipped / "Daten" / "\xFC\xFF.txt", "x");
    EXPECT_EQ(choose(), user);
    EXPECT_EQ(get(user / "Daten" / "\xFC\xFF.txt"), "x");
    EXPECT_EQ(problem, "");
}

TEST_F(DataPlaceTest, ShippedDataThatNobodyMayLookIntoAreReported) {
    fs::permissions(shipped, fs::perms::none);
    {
        const Unprivileged ordinary;
        EXPECT_EQ(choose(), user);
    }
    fs::permissions(shipped, fs::perms::all);
    EXPECT_NE(problem.find((shipped / "Daten").string()), std::string::npos) << problem;
}

TEST_F(DataPlaceTest, OnAFullDiskNoHalfFileStaysBehind) {
    put(shipped / "Daten" / "Datenset1.INI", std::string(10000, 'x'));
    {
        const FullDisk disk(4096);  // copying gets stuck half-way
        choose();
    }
    EXPECT_NE(problem.find("Datenset1.INI"), std::string::npos) << problem;
    EXPECT_FALSE(fs::exists(user / "Daten" / "Datenset1.INI"));
    choose();  // with room again
    EXPECT_EQ(get(user / "Daten" / "Datenset1.INI"), std::string(10000, 'x'));
}

TEST_F(DataPlaceTest, AShippedFolderThatNobodyMayLookIntoCountsAsNone) {
    fs::create_directories(program / "Daten");
    fs::create_directories(shipped / "kdx-rds" / "Daten");
    fs::permissions(shipped, fs::perms::none);
    {
        const Unprivileged ordinary;
        EXPECT_EQ(shippedFolder(program), program);
    }
    fs::permissions(shipped, fs::perms::all);
    EXPECT_EQ(shippedFolder(program), shipped / "kdx-rds");
}

}  // namespace
}  // namespace kdx::test
