#pragma once

#include "link/visa.h"

#include <chrono>
#include <memory>
#include <optional>
#include <span>
#include <string>
#include <vector>

namespace kdx {

/// What came of the search for an installed VISA library.
struct VisaLibrary {
    std::unique_ptr<Visa> visa;  ///< null when there is none
    std::string file;            ///< the file that was loaded; empty when there is none
    /// Why the libraries tried before (all of them when there is none) cannot be used: a line for each, "name: cause".
    std::string reason;
};

/// Loads the first of these libraries that can be loaded and has the operations; the description of statuses may be
/// missing, then ours stand in. A bare name is looked for only where the system keeps its libraries.
/// @param answerTime how long an answer may take; the library's own time if left out
VisaLibrary loadFirstVisaLibrary(std::span<const std::string> names,
                                 std::optional<std::chrono::milliseconds> answerTime = {});

/// Loads that library and no other; with an empty text, the first of the usual names that will do.
/// @param path a file, or a bare name that the system finds where it keeps its libraries
VisaLibrary loadVisaLibrary(const std::string& path, std::optional<std::chrono::milliseconds> answerTime = {});

}  // namespace kdx
