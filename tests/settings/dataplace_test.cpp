#include "settings/dataplace.h"

#include <gtest/gtest.h>
#include <sys/resource.h>
#include <sys/wait.h>

#include <csignal>
#include <cstdlib>
#include <fstream>

#include "settings/profilefile.h"
#include "support/tempfolder.h"
#include "support/unprivileged.h"

namespace kdx::test {
namespace {

namespace fs = std::filesystem;

/// The program's folder, the user's and the shipped one; the first two have no "Daten" at first.
class DataPlaceTest : public ::testing::Test {
protected:
    DataPlaceTest() {
        fs::permissions(base.path(), fs::perms::all);
        fs::remove(base.data());
        put(shipped / "Daten" / "RDS_Allg.INI", "[BUS]\r\nINTERFACE=IEC\r\n");
        put(shipped / "Daten" / "Datenset1.INI", "[RDS]\r\nPS=SHIPPED\r\n");
        fs::create_directories(program);
    }
    static void put(const fs::path& file, const std::string& bytes) {
        fs::create_directories(file.parent_path());
        std::ofstream(file, std::ios::binary) << bytes;
    }
    static std::string get(const fs::path& file) { return readFile(file).value_or("(none)"); }
    fs::path choose() { return chooseAppFolder(places, news); }

    TempFolder base;
    fs::path program = base.path() / "program";
    fs::path user = base.path() / "home" / "kdx-rds";
    fs::path shipped = base.path() / "share";
    DataPlaces places{std::nullopt, program, user, shipped};
    DataNews news;
    std::string& problem = news.problem;
};

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

TEST_F(DataPlaceTest, NothingTheUserHasIsOverwritten) {
    put(user / "Daten" / "DATENSET1.ini", "[RDS]\r\nPS=MINE\r\n");  // the same file in other letters
    EXPECT_EQ(choose(), user);
    EXPECT_EQ(get(user / "Daten" / "DATENSET1.ini"), "[RDS]\r\nPS=MINE\r\n");
    EXPECT_FALSE(fs::exists(user / "Daten" / "Datenset1.INI"));
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

TEST_F(DataPlaceTest, AShippedFileThatCannotBeReadIsNamed) {
    fs::permissions(shipped / "Daten" / "RDS_Allg.INI", fs::perms::none);
    const Unprivileged ordinary;
    EXPECT_EQ(choose(), user);
    EXPECT_NE(problem.find("RDS_Allg.INI"), std::string::npos) << problem;
    EXPECT_FALSE(fs::exists(user / "Daten" / "RDS_Allg.INI"));
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

TEST_F(DataPlaceTest, TheShippedDataAreFoundFromTheProgramsFolder) {
    fs::remove_all(shipped);
    EXPECT_EQ(shippedFolder(program), shipped / "kdx-rds");  // what is missing is named by its usual place
    fs::create_directories(program / "Daten");
    EXPECT_EQ(shippedFolder(program), program);
    fs::create_directories(shipped / "kdx-tools" / "Daten");
    EXPECT_EQ(shippedFolder(program), shipped / "kdx-tools");
    fs::create_directories(shipped / "kdx-rds" / "Daten");
    EXPECT_EQ(shippedFolder(program), shipped / "kdx-rds");
    fs::permissions(shipped, fs::perms::none);
    {
        const Unprivileged ordinary;
        EXPECT_EQ(shippedFolder(program), program);
    }
    fs::permissions(shipped, fs::perms::all);
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
    const pid_t child = fork();
    ASSERT_GE(child, 0);
    if (child == 0) {
        // A file takes 4096 bytes at most: copying gets stuck half-way.
        std::signal(SIGXFSZ, SIG_IGN);
        const rlimit limit{4096, 4096};
        const bool limited = ::setrlimit(RLIMIT_FSIZE, &limit) == 0;
        choose();
        const bool told = problem.find("Datenset1.INI") != std::string::npos;
        _exit(limited && told ? 0 : 1);
    }
    int status = 0;
    ASSERT_EQ(::waitpid(child, &status, 0), child);
    EXPECT_EQ(status, 0);
    EXPECT_FALSE(fs::exists(user / "Daten" / "Datenset1.INI"));
    choose();  // with room again
    EXPECT_EQ(get(user / "Daten" / "Datenset1.INI"), std::string(10000, 'x'));
}

TEST_F(DataPlaceTest, ShippedFilesThatAreMarkedReadOnlyCanBeWrittenInTheUsersFolder) {
    fs::permissions(shipped / "Daten" / "Datenset1.INI", fs::perms::owner_read);
    choose();
    EXPECT_TRUE(replaceFile(user / "Daten" / "Datenset1.INI", "mine"));
}

}  // namespace
}  // namespace kdx::test
