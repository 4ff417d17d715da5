#pragma once

#include <cstddef>
#include <string>
#include <string_view>
#include <vector>

#include "air/airtime.h"

namespace kdx::air {

/// An instrument command and how long after the start it comes.
struct TimedCommand {
    Ticks after{0};
    std::string command;
};

/// What a command file holds.
struct TimedCommands {
    std::vector<TimedCommand> commands;        ///< in the order of their times
    std::vector<std::size_t> unreadableLines;  ///< counted from 1
};

/// Reads a command file: one instrument command a line, "@ 2.5 " before it when it comes 2.5 s after the start. The
/// file is Windows-1252, or UTF-8 when it begins with that encoding's mark. Empty lines are left out.
[[nodiscard]] TimedCommands readTimedCommands(std::string_view bytes);

}  // namespace kdx::air
