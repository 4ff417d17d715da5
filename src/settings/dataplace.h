#pragma once

#include <filesystem>
#include <optional>

#include "settings/shippedfiles.h"

namespace kdx {

/// Where the program looks for its folder, in this order of precedence.
struct DataPlaces {
    std::optional<std::filesystem::path> asked;  ///< given on the command line
    std::filesystem::path program;               ///< the folder of the program file
    std::filesystem::path user;                  ///< the user's own folder for this program
    std::filesystem::path shipped;               ///< holds the "Daten" that came with the program
    bool heard = true;                           ///< whether anybody hears of what is new there
};

/// The program's folder whose "Daten" is used: the one asked for; else the program's own when it holds a writable
/// "Daten"; else the user's, whose "Daten" is brought up to what is shipped. Nothing that the user changed is
/// overwritten. When the user's folder is not known (empty or relative) it is the program's, and nothing is created.
/// @param news gets a problem when the user's folder is not known or could not be filled.
[[nodiscard]] std::filesystem::path chooseAppFolder(const DataPlaces& places, DataNews& news);

/// The folder with the "Daten" that came with the program, as seen from the program's own folder: ../share/kdx-rds, or
/// ../share/kdx-tools where the programs without a window came alone; else its own. Never throws, whatever the rights.
[[nodiscard]] std::filesystem::path shippedFolder(const std::filesystem::path& program);

}  // namespace kdx
