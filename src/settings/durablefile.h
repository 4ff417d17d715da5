#pragma once

#include <filesystem>
#include <string_view>

namespace kdx {

/// What replacing a file needs of the operating system: durablefile_posix.cpp, and durablefile_portable.cpp elsewhere.

/// True when the user who runs the program may write the existing file.
[[nodiscard]] bool userMayWrite(const std::filesystem::path& file);

/// Writes a file that must not exist yet and flushes it to disk; when `model` exists, gives it the same mode and, as
/// far as the user may, the same owner and group. False on any failure; a part of the file may then be left.
[[nodiscard]] bool writeNewFile(const std::filesystem::path& file, std::string_view bytes,
                                const std::filesystem::path& model);

/// Makes a rename in the folder last through a power cut, where the system can promise that.
void flushFolder(const std::filesystem::path& folder);

}  // namespace kdx
