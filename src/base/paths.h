#pragma once

#include <filesystem>
#include <string>
#include <string_view>

namespace kdx {

/// Names of files and folders are texts in UTF-8 wherever they are no paths. Some systems keep names in another form,
/// and their standard library reads a text in the form of the user's settings: it is never to make a path of a text by
/// itself. Where names are bytes, with or without a meaning, they stay the same bytes.

/// The path of that name. Never throws: bytes that are no UTF-8 count as Windows-1252 where names have to be texts.
[[nodiscard]] std::filesystem::path pathFromUtf8(std::string_view name);

/// The name of that path. Never throws: "?" where it is no text in any encoding.
[[nodiscard]] std::string utf8Of(const std::filesystem::path& path);

}  // namespace kdx
