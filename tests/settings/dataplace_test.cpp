#include "settings/dataplace.h"

#include <gtest/gtest.h>

#include "settings/dataplacetest.h"

namespace kdx::test {
namespace {

namespace fs = std::filesystem;

TEST_F(DataPlaceTest, TheFolderAskedForWinsAsItIs) {
    fs::create_directories(program / "Daten");
    places.asked = base.path() / "elsewhere";
    EXPECT_EQ(choose(), base.path() / "elsewhere");
    EXPECT_FALSE(fs::exists(base.path() / "elsewhere"));
    EXPECT_FALSE(fs::exists(user));
    EXPECT_EQ(problem, "");
}

TEST_F(DataPlaceTest, TheProgramsOwnWritableDataAreUsed) {
    fs::create_directories(program / "DATEN");  // letter case does not count
    EXPECT_EQ(choose(), program);
    EXPECT_FALSE(fs::exists(user));
    EXPECT_TRUE(fs::is_empty(program / "DATEN"));
}

TEST_F(DataPlaceTest, WithoutDataBesideTheProgramTheUsersFolderIsFilled) {
    EXPECT_EQ(choose(), user);
    EXPECT_EQ(get(user / "Daten" / "RDS_Allg.INI"), "[BUS]\r\nINTERFACE=IEC\r\n");
    EXPECT_EQ(get(user / "Daten" / "Datenset1.INI"), "[RDS]\r\nPS=SHIPPED\r\n");
    EXPECT_EQ(problem, "");
}

TEST_F(DataPlaceTest, NothingTheUserHasIsOverwritten) {
    put(user / "Daten" / "DATENSET1.ini", "[RDS]\r\nPS=MINE\r\n");  // the same file in other letters
    EXPECT_EQ(choose(), user);
    EXPECT_EQ(get(user / "Daten" / "DATENSET1.ini"), "[RDS]\r\nPS=MINE\r\n");
    EXPECT_EQ(fs::exists(user / "Daten" / "Datenset1.INI"), !base.tellsLetterCaseApart());
    EXPECT_TRUE(fs::exists(user / "Daten" / "RDS_Allg.INI"));
}

TEST_F(DataPlaceTest, AFileThatIsShippedLaterIsAddedAtTheNextStart) {
    choose();
    put(shipped / "Daten" / "Event.txt", "Stau;1\r\n");
    choose();
    EXPECT_EQ(get(user / "Daten" / "Event.txt"), "Stau;1\r\n");
}

TEST_F(DataPlaceTest, FoldersAmongTheShippedDataAreLeftOut) {
    fs::create_directories(shipped / "Daten" / "AAA");
    EXPECT_EQ(choose(), user);
    EXPECT_EQ(problem, "");
    EXPECT_FALSE(fs::exists(user / "Daten" / "AAA"));
    EXPECT_TRUE(fs::exists(user / "Daten" / "RDS_Allg.INI"));
}

TEST_F(DataPlaceTest, MissingShippedDataAreReported) {
    fs::remove_all(shipped);
    EXPECT_EQ(choose(), user);
    EXPECT_NE(problem.find((shipped / "Daten").string()), std::string::npos) << problem;
    EXPECT_TRUE(fs::is_directory(user / "Daten"));
}

TEST_F(DataPlaceTest, AUsersFolderThatCannotBeMadeIsReported) {
    put(base.path() / "home", "a file is in the way");
    EXPECT_EQ(choose(), user);
    EXPECT_NE(problem.find(user.string()), std::string::npos) << problem;
}

TEST_F(DataPlaceTest, WithoutAUsersFolderNothingIsCreatedAndTheReasonIsTold) {
    const fs::path before = fs::current_path();
    fs::current_path(base.path());
    for (const char* unknown : {"", "kdx-rds", ".local/share/kdx-rds"}) {
        places.user = unknown;
        problem.clear();
        EXPECT_EQ(choose(), program);
        EXPECT_NE(problem.find("HOME is not set"), std::string::npos) << problem;
        EXPECT_NE(problem.find("--app-folder"), std::string::npos) << problem;
    }
    fs::current_path(before);
    EXPECT_FALSE(fs::exists(base.data()));
    EXPECT_FALSE(fs::exists(base.path() / "kdx-rds"));
    EXPECT_FALSE(fs::exists(base.path() / ".local"));
    EXPECT_TRUE(fs::is_empty(program));
}

TEST_F(DataPlaceTest, TheShippedDataAreFoundFromTheProgramsFolder) {
    fs::remove_all(shipped);
    EXPECT_EQ(shippedFolder(program), shipped / "kdx-rds");  // what is missing is named by its usual place
    fs::create_directories(program / "Daten");
    EXPECT_EQ(shippedFolder(program), program);
    fs::create_directories(shipped / "kdx-tools" / "Daten");
    EXPECT_EQ(shippedFolder(program), shipped / "kdx-tools");
    fs::create_directories(shipped / "kdx-rds" / "Daten");
    EXPECT_EQ(shippedFolder(program), shipped / "kdx-rds");
}

TEST_F(DataPlaceTest, ShippedFilesThatAreMarkedReadOnlyCanBeWrittenInTheUsersFolder) {
    fs::permissions(shipped / "Daten" / "Datenset1.INI", fs::perms::owner_read);
    choose();
    EXPECT_TRUE(replaceFile(user / "Daten" / "Datenset1.INI", "mine"));
    fs::permissions(shipped / "Daten" / "Datenset1.INI", fs::perms::owner_all);  // or Windows does not remove it
}

}  // namespace
}  // namespace kdx::test
