#pragma once

#include <ctime>

namespace kdx {

/// A point in time in the machine's time zone: localtime_posix.cpp, and localtime_windows.cpp there.
[[nodiscard]] std::tm localTime(std::time_t time);

}  // namespace kdx
