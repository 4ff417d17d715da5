#pragma once

#include <cstdint>
#include <filesystem>
#include <span>
#include <string>
#include <string_view>
#include <vector>

namespace kdx {

class DataFolder;

/// A file as it came with some version of the program.
struct ShippedVersion {
    std::string_view name;
    std::uint64_t size = 0;
    std::uint64_t digest = 0;
};

/// All versions of the shipped files that only the program's makers change, earlier ones and the present one.
[[nodiscard]] std::span<const ShippedVersion> shippedVersions();

/// FNV-1a of 64 bits. It tells versions of a file apart and keeps nobody out: who wants his file to be taken for a
/// shipped one harms himself alone. So it needs no library.
[[nodiscard]] std::uint64_t digestOf(std::string_view bytes);

/// What the user should know of his data folder.
struct DataNews {
    std::string problem;                      ///< in UTF-8, when something is wrong
    std::vector<std::filesystem::path> kept;  ///< shipped files in whose places files stay that the user changed
};

/// Gives the user's folder every shipped file that it lacks, and renews those that he never changed: what stands there
/// is an earlier version. A changed one stays, and is told once a version. The settings that the program itself writes
/// (general settings, data sets) are the user's once they are there.
/// @param shipped the folder of the shipped files; @param heard whether anybody hears of what is kept: else it is told
/// at another start.
void bringUpToDate(const DataFolder& user, const std::filesystem::path& shipped,
                   std::span<const ShippedVersion> versions, bool heard, DataNews& news);

}  // namespace kdx
