// What replacing a file promises on every system.
#include <gtest/gtest.h>

#include "settings/profilefile.h"
#include "support/tempfolder.h"

namespace kdx {
namespace {

namespace fs = std::filesystem;

class ReplaceFileTest : public ::testing::Test {
protected:
    [[nodiscard]] fs::path path(const char* name) const { return m_folder.data() / name; }
    [[nodiscard]] std::ptrdiff_t entries() const {
        return std::distance(fs::directory_iterator(m_folder.data()), fs::directory_iterator());
    }
    test::TempFolder m_folder;
};

TEST_F(ReplaceFileTest, CreatesAFileThatIsMissing) {
    EXPECT_TRUE(replaceFile(path("a.ini"), "new"));
    EXPECT_EQ(m_folder.read("a.ini"), "new");
    EXPECT_EQ(entries(), 1);
}

TEST_F(ReplaceFileTest, ReplacesTheWholeContent) {
    m_folder.write("a.ini", "something much longer");
    EXPECT_TRUE(replaceFile(path("a.ini"), std::string("a\0\r\n", 4)));
    EXPECT_EQ(m_folder.read("a.ini"), std::string("a\0\r\n", 4));
    EXPECT_EQ(entries(), 1);
}

TEST_F(ReplaceFileTest, WritesMegabytes) {
    const std::string bytes(3 << 20, 'x');
    EXPECT_TRUE(replaceFile(path("a.ini"), bytes));
    EXPECT_EQ(m_folder.read("a.ini"), bytes);
}

TEST_F(ReplaceFileTest, FailsInAMissingFolderAndCreatesNone) {
    EXPECT_FALSE(replaceFile(path("missing") / "a.ini", "new"));
    EXPECT_EQ(entries(), 0);
}

TEST_F(ReplaceFileTest, FailsWhereAFolderIsInTheFilesPlace) {
    fs::create_directory(path("a.ini"));
    EXPECT_FALSE(replaceFile(path("a.ini"), "new"));
    EXPECT_TRUE(fs::is_directory(path("a.ini")));
    EXPECT_EQ(entries(), 1);
}

TEST_F(ReplaceFileTest, LeavesAFileMarkedReadOnlyAsItIsWhoeverRunsTheProgram) {
    m_folder.write("a.ini", "old");
    fs::permissions(path("a.ini"), fs::perms::owner_read | fs::perms::group_read);
    EXPECT_FALSE(replaceFile(path("a.ini"), "new"));
    EXPECT_EQ(m_folder.read("a.ini"), "old");
    EXPECT_EQ(entries(), 1);
}

}  // namespace
}  // namespace kdx
