#pragma once

#include <atomic>
#include <chrono>

namespace kdx {

/// A point in time at which waiting ends.
using Deadline = std::chrono::steady_clock::time_point;

/// How often somebody who waits looks whether the wait is to be aborted.
inline constexpr std::chrono::milliseconds kAbortLatency{50};
/// Of waits that nobody aborts.
inline constinit const std::atomic_bool kNeverAborted = false;

}  // namespace kdx
