#pragma once

#include <filesystem>
#include <string>
#include <vector>

namespace kdx {

/// The entries of the file, a line each; lines that are none are passed over, and so is a missing file.
[[nodiscard]] std::vector<std::string> loadMessages(const std::filesystem::path& file);

/// Puts the entries in the place of those that loadMessages() gives; other lines stay, before them. False when the file
/// cannot be written, or is there and cannot be read: it is then as it was.
[[nodiscard]] bool storeMessages(const std::filesystem::path& file, const std::vector<std::string>& entries);

}  // namespace kdx
