#pragma once

#include <filesystem>
#include <string>

namespace kdx {

struct DataNews;
struct Options;

/// The folder whose "Daten" is used, as settings/dataplace.h chooses it on this system.
/// @param program the name the program was called by; @param heard whether anybody hears of the news, which are what is
/// wrong there and what has changed.
[[nodiscard]] std::filesystem::path appFolder(const Options& options, const char* program, bool heard, DataNews& news);

/// That a file stays as the user changed it, in words. @param shipped the new version that is not in its place.
[[nodiscard]] std::string keptFileText(const std::filesystem::path& shipped);

/// The folder whose "Daten" came with the program. @param program as above.
[[nodiscard]] std::filesystem::path shippedAppFolder(const char* program);

}  // namespace kdx
