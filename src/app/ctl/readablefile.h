#pragma once

#include <optional>
#include <string>
#include <vector>

namespace kdx::ctl {

class Output;

/// The bytes of a file; nothing when it cannot be read, which is told.
[[nodiscard]] std::optional<std::string> bytesOf(Output& output, const std::string& file);

/// Tells of each of the lines, counted from 1, what is wrong with it. @returns whether there are none.
bool areNone(Output& output, const std::string& file, const std::vector<std::size_t>& lines, const std::string& wrong);

}  // namespace kdx::ctl
