#pragma once

#include <filesystem>

namespace kdx {

/// Files that live for a moment only, and what a killed program leaves of them.

/// A name in the file's own folder that no other program uses and that tells whose it is.
[[nodiscard]] std::filesystem::path nameBeside(const std::filesystem::path& file);

/// The file by which is tried out whether a folder can be written.
[[nodiscard]] std::filesystem::path writableProbe(const std::filesystem::path& folder);

/// Removes the momentary files that programs left in the folder when they were killed; those of living programs stay,
/// and so does every file of another naming. For the start, before this program writes anything.
void sweepLeftovers(const std::filesystem::path& folder);

}  // namespace kdx
