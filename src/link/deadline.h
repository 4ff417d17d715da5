#pragma once

#include <chrono>

namespace kdx {

/// A point in time at which waiting ends.
using Deadline = std::chrono::steady_clock::time_point;

}  // namespace kdx
