#pragma once

#include <chrono>
#include <optional>
#include <string>
#include <vector>

namespace kdx {

/// What the command line asked for.
struct Options {
    std::optional<std::string> appFolder;                 ///< the program's folder; data in its sub-folder "Daten"
    std::optional<std::string> visaLibrary;               ///< the VISA library to load
    std::optional<std::string> tourFolder;                ///< make the tour and leave the pictures there
    std::optional<std::chrono::milliseconds> answerTime;  ///< how long an answer may take; only kdx-ctl asks for it
    bool simulate = false;
    bool views = false;  ///< the tour goes on through views and editors
    bool help = false;
    bool version = false;
    std::string error;  ///< what cannot be understood; empty when all can
};

/// Reads the command line without the program's name.
[[nodiscard]] Options parseOptions(const std::vector<std::string>& arguments);

/// The text of --help.
[[nodiscard]] std::string helpText();

}  // namespace kdx
