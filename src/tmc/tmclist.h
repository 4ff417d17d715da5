#pragma once

#include <cstddef>
#include <filesystem>
#include <optional>
#include <string>
#include <string_view>
#include <vector>

namespace kdx {

/// Characters of an entry's text as the lists show it; its code follows.
inline constexpr std::size_t kListTextLength = 42;

/// A line of an event or location file as the lists show it: the text before the first semicolon, padded or cut to 42
/// characters, and everything after it. Nothing for a line without a semicolon.
[[nodiscard]] std::optional<std::string> shownEntry(std::string_view line);

/// All entries of an event or location file as the lists show them; nothing when the file is missing or cannot be
/// read.
[[nodiscard]] std::optional<std::vector<std::string>> loadTmcList(const std::filesystem::path& file);

/// Adds the line text, semicolon, code at the file's end; creates the file when missing. The file is replaced in one
/// step, so it is whole whatever happens. False on any failure, and then the file is as it was.
[[nodiscard]] bool appendToTmcList(const std::filesystem::path& file, std::string_view text, std::string_view code);

}  // namespace kdx
