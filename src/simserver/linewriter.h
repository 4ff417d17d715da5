#pragma once

#include <cstddef>
#include <memory>
#include <string_view>
#include <thread>

namespace kdx::simserver {

/// Prints lines without ever holding up who has them printed: a thread of its own does the writing. When nobody reads
/// on the other side, lines that find no room any more are dropped, and a line says how many.
class LineWriter {
public:
    /// Bytes of lines that wait to be written.
    static constexpr std::size_t kMostWaiting = std::size_t{256} * 1024;

    /// @param descriptor where the lines go, borrowed; @param mostWaiting bytes.
    explicit LineWriter(int descriptor, std::size_t mostWaiting = kMostWaiting);
    LineWriter(const LineWriter&) = delete;
    LineWriter& operator=(const LineWriter&) = delete;
    /// Gives the lines that still wait half a second.
    ~LineWriter();

    void print(std::string_view line);
    /// Bytes that are no line. False when there is no room for them: they are dropped, and no line says so.
    [[nodiscard]] bool pass(std::string_view bytes);
    /// Whether something could not be written: nothing is any more then.
    [[nodiscard]] bool isLost() const;

private:
    struct Shared;
    static void write(Shared& shared, int descriptor);

    std::size_t m_mostWaiting;
    std::shared_ptr<Shared> m_shared;  // the thread's too, which may have to be left behind in its write
    std::thread m_thread;
};

}  // namespace kdx::simserver
