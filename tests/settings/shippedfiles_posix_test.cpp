// Shipped files in folders without rights and on a full disk.
#include <gtest/gtest.h>

#include "settings/shippedfilestest.h"
#include "support/fulldisk.h"
#include "support/unprivileged.h"

namespace kdx::test {
namespace {

namespace fs = std::filesystem;

TEST_F(ShippedFilesTest, AFolderThatCannotBeWrittenIsToldAndStaysAsItIs) {
    base.write("Event.txt", kEarlier);
    fs::permissions(base.data(),
                    fs::perms::owner_read | fs::perms::owner_exec | fs::perms::others_read | fs::perms::others_exec);
    {
        const Unprivileged ordinary;
        EXPECT_NE(start().problem.find("Event.txt"), std::string::npos);
    }
    EXPECT_EQ(base.read("Event.txt"), kEarlier);
    fs::permissions(base.data(), fs::perms::all);
    EXPECT_EQ(start().problem, "");
    EXPECT_EQ(base.read("Event.txt"), kPresent);
}

TEST_F(ShippedFilesTest, InAFolderThatCannotBeWrittenAChangedFileIsToldAgain) {
    base.write("Event.txt", "Mein Ereignis;999\r\n");
    fs::permissions(base.data(),
                    fs::perms::owner_read | fs::perms::owner_exec | fs::perms::others_read | fs::perms::others_exec);
    const Unprivileged ordinary;
    for (int i = 0; i < 2; ++i) {
        const DataNews news = start();
        EXPECT_EQ(news.problem, "");
        EXPECT_EQ(news.kept.size(), 1U);
    }
}

TEST_F(ShippedFilesTest, OnAFullDiskTheEarlierVersionStaysWhole) {
    ship("Event.txt", std::string(10000, 'x'));
    base.write("Event.txt", kEarlier);
    {
        const FullDisk disk(4096);  // writing gets stuck half-way
        EXPECT_NE(start().problem.find("Event.txt"), std::string::npos);
    }
    EXPECT_EQ(base.read("Event.txt"), kEarlier);
    start();  // with room again
    EXPECT_EQ(base.read("Event.txt"), std::string(10000, 'x'));
}

}  // namespace
}  // namespace kdx::test
