#pragma once

#include <filesystem>
#include <string>

namespace kdx {

struct Options;

/// The folder whose "Daten" is used, as settings/dataplace.h chooses it on this system.
/// @param program the name the program was called by; @param problem gets a message, in UTF-8, when something is wrong.
[[nodiscard]] std::filesystem::path appFolder(const Options& options, const char* program, std::string& problem);

/// The folder whose "Daten" came with the program. @param program as above.
[[nodiscard]] std::filesystem::path shippedAppFolder(const char* program);

}  // namespace kdx
