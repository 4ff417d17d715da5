#include <gtest/gtest.h>

#include "support/unprivileged.h"
#include "tmc/tmclisttest.h"

namespace kdx {
namespace {

namespace fs = std::filesystem;

TEST_F(TmcListTest, AFileThatCannotBeReplacedKeepsItsContent) {
    write("Stau;00101\r\n");
    fs::permissions(m_folder.data(),
                    fs::perms::owner_read | fs::perms::owner_exec | fs::perms::others_read | fs::perms::others_exec);
    {
        const test::Unprivileged user;
        EXPECT_FALSE(appendToTmcList(file(), "Unfall", "00201"));
    }
    fs::permissions(m_folder.data(), fs::perms::owner_all);
    EXPECT_EQ(content(), "Stau;00101\r\n");
    EXPECT_EQ(filesInFolder(), 1);
}

TEST_F(TmcListTest, AFileThatCannotBeReadIsNotReplaced) {
    write("Stau;00101\r\n");
    fs::permissions(m_folder.data(), fs::perms::all);
    fs::permissions(file(), fs::perms::owner_write | fs::perms::others_write);
    {
        const test::Unprivileged user;
        EXPECT_EQ(entries(), std::nullopt);
        EXPECT_FALSE(appendToTmcList(file(), "Unfall", "00201"));
    }
    fs::permissions(file(), fs::perms::owner_all);
    EXPECT_EQ(content(), "Stau;00101\r\n");
}

}  // namespace
}  // namespace kdx
