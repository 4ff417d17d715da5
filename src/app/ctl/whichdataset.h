#pragma once

#include <optional>
#include <string>

#include "settings/profile.h"

namespace CLI {
class App;
}

namespace kdx::ctl {

class Laboratory;

/// The data set that a subcommand works with, as the command line names it.
struct WhichDataSet {
    std::optional<int> number;
    std::string file;

    void addTo(CLI::App& command);
    [[nodiscard]] bool isNamed() const { return number || !file.empty(); }
    /// Makes it the one at work; nothing when none is named or it cannot be read, which is told.
    [[nodiscard]] std::optional<Profile> profile(Laboratory& laboratory) const;
};

}  // namespace kdx::ctl
