#pragma once

#include "simserver/socket.h"

#include <atomic>
#include <chrono>
#include <cstdint>
#include <functional>
#include <map>
#include <utility>

namespace kdx::simserver {

/// Waits for many sockets and points in time at once and calls back: everything runs in the one thread inside run().
class PollLoop {
public:
    using TimePoint = std::chrono::steady_clock::time_point;
    using TimerId = std::pair<TimePoint, std::uint64_t>;

    /// Throws std::system_error when the system has no descriptors left.
    PollLoop();

    /// Calls back with what poll() reported for the descriptor (POLLIN, POLLOUT, POLLHUP ...).
    void watch(int descriptor, short events, std::function<void(short)> callback);
    /// Changes what a watched descriptor is watched for.
    void setEvents(int descriptor, short events);
    /// Ends the watching; to be called before the descriptor is closed.
    void forget(int descriptor);

    /// Calls back once, when the time has come.
    TimerId callAt(TimePoint when, std::function<void()> callback);
    /// Takes a call back; one that has run already is left alone.
    void cancel(const TimerId& timer);

    /// Serves until stop() was called, before or during the run.
    void run();
    /// Ends run(); may be called from any thread and from a signal handler.
    void stop();

private:
    struct Watch {
        std::uint64_t serial = 0;
        short events = 0;
        std::function<void(short)> callback;
    };
    void waitOnce();
    void runTimers();

    std::map<int, Watch> m_watches;
    std::map<TimerId, std::function<void()>> m_timers;
    std::uint64_t m_serial = 0;
    std::atomic<bool> m_stopped = false;
    FileDescriptor m_wakeUpRead;
    FileDescriptor m_wakeUpWrite;
};

}  // namespace kdx::simserver
