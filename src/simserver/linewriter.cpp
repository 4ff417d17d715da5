#include "simserver/linewriter.h"

#include <unistd.h>

#include <cerrno>
#include <chrono>
#include <condition_variable>
#include <mutex>
#include <string>
#include <utility>

namespace kdx::simserver {
namespace {

constexpr std::chrono::milliseconds kFarewell{500};

bool writeAll(int descriptor, std::string_view bytes) {
    while (!bytes.empty()) {
        const ssize_t count = ::write(descriptor, bytes.data(), bytes.size());
        if (count < 0 && errno == EINTR) continue;
        if (count <= 0) return false;
        bytes.remove_prefix(static_cast<std::size_t>(count));
    }
    return true;
}

}  // namespace

struct LineWriter::Shared {
    std::mutex mutex;
    std::condition_variable changed;
    std::string waiting;
    std::size_t dropped = 0;  // since the last line that found room
    bool works = true;        // once the reader has gone there is nothing left to do but to take the lines away
    bool ending = false;
    bool ended = false;

    void sayWhatWasDropped() {
        if (dropped > 0) waiting += std::to_string(std::exchange(dropped, 0)) + " lines dropped that nobody read\n";
    }
};

LineWriter::LineWriter(int descriptor, std::size_t mostWaiting)
    : m_mostWaiting(mostWaiting),
      m_shared(std::make_shared<Shared>()),
      m_thread([shared = m_shared, descriptor] { write(*shared, descriptor); }) {}

LineWriter::~LineWriter() {
    std::unique_lock guard(m_shared->mutex);
    m_shared->ending = true;
    m_shared->changed.notify_all();
    const bool ended = m_shared->changed.wait_for(guard, kFarewell, [this] { return m_shared->ended; });
    guard.unlock();
    if (ended) {
        m_thread.join();
    } else {
        m_thread.detach();  // its write may never come back
    }
}

void LineWriter::print(std::string_view line) {
    const std::lock_guard guard(m_shared->mutex);
    if (m_shared->waiting.size() + line.size() >= m_mostWaiting) {
        ++m_shared->dropped;
        return;
    }
    m_shared->sayWhatWasDropped();
    m_shared->waiting.append(line).append("\n");
    m_shared->changed.notify_all();
}

bool LineWriter::pass(std::string_view bytes) {
    const std::lock_guard guard(m_shared->mutex);
    if (m_shared->waiting.size() + bytes.size() >= m_mostWaiting) return false;
    m_shared->waiting.append(bytes);
    m_shared->changed.notify_all();
    return true;
}

bool LineWriter::isLost() const {
    const std::lock_guard guard(m_shared->mutex);
    return !m_shared->works;
}

void LineWriter::write(Shared& shared, int descriptor) {
    std::unique_lock guard(shared.mutex);
    for (;;) {
        shared.changed.wait(guard, [&] { return shared.ending || !shared.waiting.empty(); });
        if (shared.ending) shared.sayWhatWasDropped();
        if (shared.waiting.empty()) break;
        const std::string bytes = std::exchange(shared.waiting, {});
        if (!shared.works) continue;
        guard.unlock();
        const bool written = writeAll(descriptor, bytes);
        guard.lock();
        shared.works = written;
    }
    shared.ended = true;
    shared.changed.notify_all();
}

}  // namespace kdx::simserver
