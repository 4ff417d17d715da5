#pragma once

#include <optional>
#include <string>
#include <vector>

#include "air/timedcommands.h"
#include "app/ctl/whichdataset.h"

namespace kdx::ctl {

/// What is done to the virtual instrument whose transmission is looked at, as the command line names it.
struct AirCommands {
    WhichDataSet source;
    std::string log;
    std::string commandFile;

    void addTo(CLI::App& command);
};

/// All of it in its order, the data set first; nothing when a part cannot be read, which is told.
[[nodiscard]] std::optional<std::vector<air::TimedCommand>> commandsOf(Laboratory& laboratory, const AirCommands& what);

}  // namespace kdx::ctl
