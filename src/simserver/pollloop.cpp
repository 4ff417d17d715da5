#include "simserver/pollloop.h"

#include <fcntl.h>
#include <poll.h>
#include <unistd.h>

#include <algorithm>
#include <cerrno>
#include <system_error>
#include <vector>

namespace kdx::simserver {
namespace {

constexpr std::chrono::milliseconds kLongestWait = std::chrono::hours(1);

}  // namespace

PollLoop::PollLoop() {
    int ends[2];
    if (::pipe2(ends, O_NONBLOCK | O_CLOEXEC) != 0) throw std::system_error(errno, std::generic_category(), "pipe");
    m_wakeUpRead = FileDescriptor(ends[0]);
    m_wakeUpWrite = FileDescriptor(ends[1]);
    // Once written to, the pipe stays readable: run() ends at once from then on.
    watch(ends[0], POLLIN, [](short) {});
}

void PollLoop::watch(int descriptor, short events, std::function<void(short)> callback) {
    m_watches[descriptor] = Watch{++m_serial, events, std::move(callback)};
}

void PollLoop::setEvents(int descriptor, short events) {
    m_watches.at(descriptor).events = events;
}

void PollLoop::forget(int descriptor) {
    m_watches.erase(descriptor);
}

PollLoop::TimerId PollLoop::callAt(TimePoint when, std::function<void()> callback) {
    const TimerId timer{when, ++m_serial};
    m_timers.emplace(timer, std::move(callback));
    return timer;
}

void PollLoop::cancel(const TimerId& timer) {
    m_timers.erase(timer);
}

void PollLoop::run() {
    while (!m_stopped) {
        waitOnce();
        runTimers();
    }
}

void PollLoop::stop() {
    const int keptErrno = errno;  // a signal handler must leave it as it was
    m_stopped = true;
    const char byte = 0;
    [[maybe_unused]] const ssize_t written = ::write(m_wakeUpWrite.number(), &byte, 1);
    errno = keptErrno;
}

void PollLoop::waitOnce() {
    std::vector<pollfd> polled;
    std::vector<std::uint64_t> serials;
    for (const auto& [descriptor, watched] : m_watches) {
        polled.push_back({descriptor, watched.events, 0});
        serials.push_back(watched.serial);
    }
    auto wait = kLongestWait;
    if (!m_timers.empty()) {
        const auto left = m_timers.begin()->first.first - std::chrono::steady_clock::now();
        wait = std::clamp(std::chrono::ceil<std::chrono::milliseconds>(left), std::chrono::milliseconds(0), wait);
    }
    if (::poll(polled.data(), polled.size(), static_cast<int>(wait.count())) < 0) {
        if (errno == EINTR) return;
        throw std::system_error(errno, std::generic_category(), "poll");
    }
    for (std::size_t i = 0; i < polled.size(); ++i) {
        if (polled[i].revents == 0) continue;
        const auto found = m_watches.find(polled[i].fd);
        // An earlier callback of this round may have closed the descriptor, and a new one may bear its number.
        if (found == m_watches.end() || found->second.serial != serials[i]) continue;
        const auto callback = found->second.callback;  // a copy: it may forget its own descriptor
        callback(polled[i].revents);
    }
}

void PollLoop::runTimers() {
    const auto now = std::chrono::steady_clock::now();
    while (!m_timers.empty() && m_timers.begin()->first.first <= now) {
        const auto callback = std::move(m_timers.begin()->second);
        m_timers.erase(m_timers.begin());
        callback();
    }
}

}  // namespace kdx::simserver
