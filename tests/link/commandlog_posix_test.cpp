#include <gtest/gtest.h>

#include <fcntl.h>
#include <sys/stat.h>
#include <sys/sysmacros.h>
#include <unistd.h>

#include "base/filedescriptor.h"
#include "link/commandlogtest.h"
#include "support/fulldisk.h"

namespace kdx {
namespace {

namespace fs = std::filesystem;

TEST_F(CommandLogTest, WhatALinkInItsPlaceLeadsToIsLeftAlone) {
    const fs::path thesis = m_folder.path() / "thesis.txt";
    m_folder.write("../thesis.txt", "ten years");
    fs::create_symlink(thesis, place());
    writeAndEmpty();
    EXPECT_EQ(m_folder.read("../thesis.txt"), "ten years");
    EXPECT_TRUE(fs::is_symlink(place()));
    EXPECT_FALSE(m_log.isWritable());
    EXPECT_EQ(m_changes, 1);
}

TEST_F(CommandLogTest, ALinkThatLeadsNowhereCreatesNothing) {
    fs::create_symlink(m_folder.path() / "new.txt", place());
    writeAndEmpty();
    EXPECT_FALSE(fs::exists(m_folder.path() / "new.txt"));
    EXPECT_FALSE(m_log.isWritable());
}

TEST_F(CommandLogTest, NobodyWaitsForTheReaderOfAPipe) {
    ASSERT_EQ(mkfifo(place().c_str(), 0600), 0);
    writeAndEmpty();
    EXPECT_FALSE(m_log.isWritable());
}

TEST_F(CommandLogTest, APipeThatIsReadGetsNothing) {
    ASSERT_EQ(mkfifo(place().c_str(), 0600), 0);
    const FileDescriptor reader(::open(place().c_str(), O_RDONLY | O_NONBLOCK | O_CLOEXEC));
    writeAndEmpty();
    char byte = 0;
    EXPECT_EQ(::read(reader.number(), &byte, 1), 0) << "end of file: no writer, no byte";
    EXPECT_FALSE(m_log.isWritable());
}

TEST_F(CommandLogTest, ADeviceInItsPlaceIsLeftAlone) {
    if (mknod(place().c_str(), S_IFCHR | 0600, makedev(1, 3)) != 0) GTEST_SKIP() << "only an administrator makes one";
    m_log.empty();
    EXPECT_FALSE(m_log.isWritable());
}

TEST_F(CommandLogTest, AFullDiskIsToldUntilThereIsRoom) {
    {
        const test::FullDisk disk;
        m_log.append("PS= 1");
        m_log.append("PS= 2");
        EXPECT_FALSE(m_log.isWritable());
        EXPECT_EQ(m_changes, 1);
    }
    m_log.append("PS= 3");
    EXPECT_TRUE(m_log.isWritable());
    EXPECT_EQ(m_changes, 2);
    EXPECT_EQ(m_folder.read(kCommandLog), "PS= 3\r\n");
}

}  // namespace
}  // namespace kdx
