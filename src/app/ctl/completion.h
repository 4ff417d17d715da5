#pragma once

#include <string>
#include <vector>

namespace CLI {
class App;
}

namespace kdx::ctl {

/// The command of that name; null when there is none.
[[nodiscard]] const CLI::App* commandNamed(const CLI::App& commands, const std::string& name);

/// What the last word of a line may become that was begun so: commands, their options, keys ("PS="), read-backs.
[[nodiscard]] std::vector<std::string> completions(const CLI::App& commands, const std::string& begun);

}  // namespace kdx::ctl
