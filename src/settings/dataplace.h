#pragma once

#include <filesystem>
#include <optional>
#include <string>

namespace kdx {

/// Where the program looks for its folder, in this order of precedence.
struct DataPlaces {
    std::optional<std::filesystem::path> asked;  ///< given on the command line
    std::filesystem::path program;               ///< the folder of the program file
    std::filesystem::path user;                  ///< the user's own folder for this program
    std::filesystem::path shipped;               ///< holds the "Daten" that came with the program
};

/// The program's folder whose "Daten" is used: the one asked for; else the program's own when it holds a writable
/// "Daten"; else the user's, whose "Daten" gets every shipped file it does not have yet. Nothing is ever overwritten.
/// When the user's folder is not known (empty or relative) it is the program's, and nothing is created.
/// @param problem gets a message, in UTF-8, when the user's folder is not known or could not be filled.
[[nodiscard]] std::filesystem::path chooseAppFolder(const DataPlaces& places, std::string& problem);

/// The folder with the "Daten" that came with the program, as seen from the program's own folder: ../share/kdx-rds, or
/// ../share/kdx-tools where the programs without a window came alone; else its own. Never throws, whatever the rights.
[[nodiscard]] std::filesystem::path shippedFolder(const std::filesystem::path& program);

}  // namespace kdx
