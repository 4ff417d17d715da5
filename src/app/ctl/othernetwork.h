#pragma once

#include <optional>
#include <string>

namespace CLI {
class App;
}

namespace kdx::ctl {

/// Adds --eon PI: the other network that the call is about.
void addOtherNetwork(CLI::App& command, std::optional<std::string>& pi);

}  // namespace kdx::ctl
