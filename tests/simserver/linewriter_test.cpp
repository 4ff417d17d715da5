#include "simserver/linewriter.h"

#include "base/filedescriptor.h"

#include <gtest/gtest.h>
#include <unistd.h>

#include <array>
#include <csignal>
#include <memory>
#include <string>
#include <thread>

namespace kdx::simserver {
namespace {

/// A pipe that nobody reads until readAll().
class LineWriterTest : public ::testing::Test {
protected:
    LineWriterTest() {
        std::array<int, 2> ends{};
        EXPECT_EQ(::pipe(ends.data()), 0);
        m_read = FileDescriptor(ends[0]);
        m_write = FileDescriptor(ends[1]);
        m_writer = std::make_unique<LineWriter>(m_write.number());
    }
    /// Everything that is printed until the writer and its end of the pipe are gone.
    std::string readAll() {
        std::thread ending([this] {
            m_writer.reset();
            m_write.close();
        });
        std::string all;
        std::array<char, 65536> piece;
        for (;;) {
            const ssize_t count = ::read(m_read.number(), piece.data(), piece.size());
            if (count <= 0) break;
            all.append(piece.data(), static_cast<std::size_t>(count));
        }
        ending.join();
        return all;
    }

    FileDescriptor m_read;
    FileDescriptor m_write;
    std::unique_ptr<LineWriter> m_writer;
};

TEST_F(LineWriterTest, LinesComeOutInOrder) {
    m_writer->print("one");
    m_writer->print("");
    m_writer->print("two");
    EXPECT_EQ(readAll(), "one\n\ntwo\n");
}

TEST_F(LineWriterTest, LinesThatNobodyReadsHoldUpNobodyAndAreCounted) {
    const std::string line(999, 'x');
    constexpr std::size_t kLines = 2000;
    for (std::size_t i = 0; i < kLines; ++i) m_writer->print(line);
    const std::string all = readAll();
    std::size_t printed = 0;
    std::size_t dropped = 0;
    for (std::size_t at = 0; at < all.size(); at = all.find('\n', at) + 1) {
        if (all.compare(at, line.size(), line) == 0) {
            ++printed;
        } else {
            dropped += std::stoul(all.substr(at));
        }
    }
    EXPECT_GT(dropped, 0U);
    EXPECT_EQ(printed + dropped, kLines);
}

TEST(LineWriter, EndsThoughNobodyReads) {
    std::signal(SIGPIPE, SIG_IGN);  // the thread that is left behind writes when the reader has gone
    std::array<int, 2> ends{};
    ASSERT_EQ(::pipe(ends.data()), 0);
    const FileDescriptor read(ends[0]);
    // Closed by the end of the process, because the thread may still have it.
    LineWriter writer(ends[1]);
    for (int i = 0; i < 500; ++i) writer.print(std::string(999, 'x'));
}

}  // namespace
}  // namespace kdx::simserver
