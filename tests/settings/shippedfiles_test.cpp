#include "settings/shippedfiles.h"

#include <gtest/gtest.h>

#include <algorithm>
#include <array>
#include <thread>

#include "settings/folderlock.h"
#include "settings/profilefile.h"
#include "settings/shippedfilestest.h"
#include "support/sourcefolder.h"

namespace kdx::test {
namespace {

namespace fs = std::filesystem;

TEST_F(ShippedFilesTest, AnEarlierVersionIsRenewed) {
    for (const char* earlier : {kEarliest, kEarlier}) {
        base.write("Event.txt", earlier);
        const DataNews news = start();
        EXPECT_EQ(news.problem, "");
        EXPECT_TRUE(news.kept.empty());
        EXPECT_EQ(base.read("Event.txt"), kPresent);
    }
}

TEST_F(ShippedFilesTest, AnEarlierVersionIsRenewedInItsPlaceWhateverItsLetters) {
    base.write("EVENT.TXT", kEarlier);
    start();
    EXPECT_EQ(base.read("EVENT.TXT"), kPresent);
    EXPECT_EQ(fs::exists(base.data() / "Event.txt"), !base.tellsLetterCaseApart());
}

TEST_F(ShippedFilesTest, AnEarlierVersionOfAnotherFileIsAChangedOne) {
    ship("Location.txt", "Aachen;1\r\n");
    base.write("Location.txt", kEarlier);
    EXPECT_EQ(start().kept, std::vector{shipped / "Location.txt"});
    EXPECT_EQ(base.read("Location.txt"), kEarlier);
}

TEST_F(ShippedFilesTest, AChangedFileIsKeptAndToldOnce) {
    const std::string mine = std::string(kEarlier) + "Mein Ereignis;999\r\n";
    base.write("Event.txt", mine);
    EXPECT_EQ(start().kept, std::vector{shipped / "Event.txt"});
    EXPECT_TRUE(start().kept.empty());
    EXPECT_EQ(base.read("Event.txt"), mine);
    // A change of his own is nothing new to the user, a newer version is.
    base.write("Event.txt", mine + "Noch eines;998\r\n");
    EXPECT_TRUE(start().kept.empty());
    ship("Event.txt", "Nebel;1301\r\n");
    EXPECT_EQ(start().kept, std::vector{shipped / "Event.txt"});
    EXPECT_TRUE(start().kept.empty());
}

TEST_F(ShippedFilesTest, WhatNobodyHearsIsToldLater) {
    base.write("Event.txt", "Mein Ereignis;999\r\n");
    EXPECT_TRUE(start(false).kept.empty());
    EXPECT_EQ(start().kept, std::vector{shipped / "Event.txt"});
}

TEST_F(ShippedFilesTest, WhoHasChangedThePresentVersionHearsNothing) {
    start();
    EXPECT_EQ(base.read("Event.txt"), kPresent);
    base.write("Event.txt", std::string(kPresent) + "Mein Ereignis;999\r\n");
    EXPECT_TRUE(start().kept.empty());
}

TEST_F(ShippedFilesTest, SettingsThatTheProgramWritesAreNeverReplacedNorTold) {
    for (const char* name : {"RDS_Allg.INI", "Datenset1.INI", "datenset5.ini"}) {
        ship(name, kPresent);
        versions.push_back({name, 10, digestOf(kEarlier)});
        base.write(name, kEarlier);
    }
    const DataNews news = start();
    EXPECT_TRUE(news.kept.empty());
    for (const char* name : {"RDS_Allg.INI", "Datenset1.INI", "datenset5.ini"}) EXPECT_EQ(base.read(name), kEarlier);
}

TEST_F(ShippedFilesTest, AHalfWrittenFileIsAChangedOne) {
    base.write("Event.txt", std::string(kEarlier).substr(0, 5));
    EXPECT_EQ(start().kept, std::vector{shipped / "Event.txt"});
    EXPECT_EQ(base.read("Event.txt"), "Stau;");
}

TEST_F(ShippedFilesTest, OfAHalfWrittenListOfWhatWasToldTheWholeLinesCount) {
    ship("Location.txt", "Aachen;1\r\n");
    base.write("Event.txt", "Mein Ereignis;999\r\n");
    base.write("Location.txt", "Mein Ort;999\r\n");
    EXPECT_EQ(start().kept.size(), 2U);
    const std::string told = base.read("kdx-rds-shipped.txt");
    base.write("kdx-rds-shipped.txt", told.substr(0, told.find('\n') + 9));
    EXPECT_EQ(start().kept, std::vector{shipped / "Location.txt"});
    for (const char* garbage : {"", "\n", " ", "\n\n \n  \n", "1 2 3 4"}) {
        base.write("kdx-rds-shipped.txt", garbage);
        EXPECT_EQ(start().kept.size(), 2U);
        EXPECT_NE(base.read("kdx-rds-shipped.txt").find(told), std::string::npos);
    }
}

TEST_F(ShippedFilesTest, AFileMarkedReadOnlyIsNotRenewed) {
    base.write("Event.txt", kEarlier);
    fs::permissions(base.data() / "Event.txt", fs::perms::owner_read);
    EXPECT_NE(start().problem.find("Event.txt"), std::string::npos);
    EXPECT_EQ(base.read("Event.txt"), kEarlier);
}

TEST_F(ShippedFilesTest, WhatIsNoFileIsLeftAlone) {
    fs::create_directories(base.data() / "Event.txt");
    const DataNews news = start();
    EXPECT_EQ(news.problem, "");
    EXPECT_TRUE(news.kept.empty());
    EXPECT_TRUE(fs::is_directory(base.data() / "Event.txt"));
}

TEST_F(ShippedFilesTest, WhatAnotherProgramAppendsMeanwhileIsNotLost) {
    base.write("Event.txt", kEarlier);
    std::thread program;
    const bool ran = underFolderLock(base.data(), [&] {
        program = std::thread([this] { (void)start(); });
        std::this_thread::sleep_for(std::chrono::milliseconds(50));
        base.write("Event.txt", std::string(kEarlier) + "Mein Ereignis;999\r\n");
    });
    program.join();
    EXPECT_TRUE(ran);
    EXPECT_EQ(base.read("Event.txt"), std::string(kEarlier) + "Mein Ereignis;999\r\n");
}

TEST_F(ShippedFilesTest, AFolderThatAnotherProgramHoldsForLongIsToldAndLeftAlone) {
    base.write("Event.txt", kEarlier);
    DataNews news;
    const bool ran = underFolderLock(base.data(), [&] { news = start(); });
    EXPECT_TRUE(ran);
    EXPECT_NE(news.problem.find("Daten"), std::string::npos);
    EXPECT_EQ(base.read("Event.txt"), kEarlier);
}

TEST_F(ShippedFilesTest, ProgramsThatStartTogetherRenewOnceAndTellOnce) {
    ship("Location.txt", "Aachen;1\r\n");
    base.write("Event.txt", kEarlier);
    base.write("Location.txt", "Mein Ort;999\r\n");
    std::array<DataNews, 4> news;
    std::vector<std::thread> programs;
    programs.reserve(news.size());
    for (DataNews& one : news) programs.emplace_back([this, &one] { one = start(); });
    for (std::thread& program : programs) program.join();
    std::size_t told = 0;
    for (const DataNews& one : news) {
        EXPECT_EQ(one.problem, "");
        told += one.kept.size();
    }
    EXPECT_EQ(told, 1U);
    EXPECT_EQ(base.read("Event.txt"), kPresent);
    EXPECT_EQ(base.read("Location.txt"), "Mein Ort;999\r\n");
}

TEST(ShippedVersions, TheDigestIsFnv1a) {
    EXPECT_EQ(digestOf(""), 0xcbf29ce484222325);
    EXPECT_EQ(digestOf("a"), 0xaf63dc4c8601ec8c);
    EXPECT_EQ(digestOf("foobar"), 0x85944171f73967e8);
}

TEST(ShippedVersions, TheTableKnowsTheFirstEventListAndAllThatIsShippedNow) {
    const auto isKnown = [](const std::string& name, const std::string& bytes) {
        return std::ranges::any_of(shippedVersions(), [&](const ShippedVersion& version) {
            return version.name == name && version.size == bytes.size() && version.digest == digestOf(bytes);
        });
    };
    EXPECT_TRUE(isKnown("Event.txt", readFile(sourceFolder() / "tests/settings/event_earlier.txt").value()));
    for (const char* name : {kEventList, kLocationList, kLanguageFile, kPictureOn, kPictureOff}) {
        EXPECT_TRUE(isKnown(name, readFile(sourceFolder() / "Daten" / name).value()))
            << name << " has changed: run packaging/shipped-versions";
    }
}

}  // namespace
}  // namespace kdx::test
