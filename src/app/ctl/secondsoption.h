#pragma once

#include <chrono>
#include <functional>
#include <string>

namespace CLI {
class App;
}

namespace kdx::ctl {

/// An option that takes a time in seconds.
struct SecondsOption {
    std::string name;  ///< "--wait"
    std::chrono::milliseconds least{};
    std::chrono::milliseconds most{};
    std::string range;  ///< the two in words, for a time beyond them: "0 to 60"
    std::string meaning;
};

/// Adds the option to the command; `take` hears of the time when it is given and lies in the range.
void addSeconds(CLI::App& command, const SecondsOption& option,
                const std::function<void(std::chrono::milliseconds)>& take);

}  // namespace kdx::ctl
