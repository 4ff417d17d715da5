#pragma once

#include <filesystem>
#include <string>
#include <string_view>

namespace kdx {

/// A file's or folder's name for people, in UTF-8: bytes that are no UTF-8 and control characters appear as \x and two
/// hexadecimal digits, everything else as it is. Never throws: any name a disk can hold can be shown.
[[nodiscard]] std::string shownPath(const std::filesystem::path& path);
/// The same with a text that has such names in it, or may have.
[[nodiscard]] std::string shownText(std::string_view text);

/// Whether two names are of one file, be it there already or not. Empty names are of none.
[[nodiscard]] bool isSameFile(const std::filesystem::path& one, const std::filesystem::path& other);

}  // namespace kdx
