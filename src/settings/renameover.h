#pragma once

#include <filesystem>
#include <functional>
#include <system_error>

namespace kdx {

class Clock;

/// As std::filesystem::rename.
using Rename =
    std::function<void(const std::filesystem::path& from, const std::filesystem::path& to, std::error_code& error)>;

/// Renames a file onto another. Some systems deny that while a third program reads there, as one that looks for viruses
/// does with what was just written: then it is tried again, for 200 ms at most. Whether it is done.
[[nodiscard]] bool renameOver(const std::filesystem::path& from, const std::filesystem::path& to, Clock& clock,
                              const Rename& rename);

}  // namespace kdx
