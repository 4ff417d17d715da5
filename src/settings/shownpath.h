#pragma once

#include <filesystem>
#include <string>

namespace kdx {

/// A file's or folder's name for people, in UTF-8: bytes that are no UTF-8 and control characters appear as \x and two
/// hexadecimal digits, everything else as it is. Never throws: any name a disk can hold can be shown.
[[nodiscard]] std::string shownPath(const std::filesystem::path& path);

}  // namespace kdx
