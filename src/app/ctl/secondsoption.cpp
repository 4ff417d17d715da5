#include "app/ctl/secondsoption.h"

#include <CLI/CLI.hpp>

#include "base/duration.h"

namespace kdx::ctl {

void addSeconds(CLI::App& command, const SecondsOption& option,
                const std::function<void(std::chrono::milliseconds)>& take) {
    command
        .add_option_function<std::string>(
            option.name,
            [option, take](const std::string& text) {
                const auto time = parseDuration(text + " s");
                if (!time || *time < option.least || *time > option.most) {
                    throw CLI::ValidationError(option.name, "takes " + option.range + " seconds, not \"" + text + "\"");
                }
                take(*time);
            },
            option.meaning)
        ->type_name("SECONDS");
}

}  // namespace kdx::ctl
