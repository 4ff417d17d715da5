#include "link/commandlog.h"
#include "link/commandlogtest.h"

#include <gtest/gtest.h>

#include <filesystem>
#include <string>

namespace kdx {
namespace {

namespace fs = std::filesystem;

TEST_F(CommandLogTest, IsMadeEmptiedAndAddedTo) {
    m_log.append("PS= 1");
    EXPECT_EQ(m_folder.read(kCommandLog), "PS= 1\r\n");
    m_log.empty();
    EXPECT_EQ(m_folder.read(kCommandLog), "");
    writeAndEmpty();
    m_log.append("PI= 2");
    EXPECT_EQ(m_folder.read(kCommandLog), "PS= 1\r\nPI= 2\r\n");
    EXPECT_TRUE(m_log.isWritable());
    EXPECT_EQ(m_changes, 0);
}

TEST_F(CommandLogTest, AFolderInItsPlaceIsLeftAlone) {
    fs::create_directory(place());
    writeAndEmpty();
    EXPECT_TRUE(fs::is_directory(place()));
    EXPECT_FALSE(m_log.isWritable());
}

TEST_F(CommandLogTest, AnotherTrySeesThatTheObstacleIsGone) {
    fs::create_directory(place());
    m_log.empty();
    m_log.retry();
    EXPECT_FALSE(m_log.isWritable());
    fs::remove(place());
    m_log.retry();
    EXPECT_TRUE(m_log.isWritable());
    EXPECT_EQ(m_folder.read(kCommandLog), "");
}

}  // namespace
}  // namespace kdx
