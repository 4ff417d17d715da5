#include "app/ctl/othernetwork.h"

#include <CLI/CLI.hpp>

#include "base/codepage.h"
#include "base/numbers.h"
#include "coder/fieldsizes.h"

namespace kdx::ctl {

void addOtherNetwork(CLI::App& command, std::optional<std::string>& pi) {
    command
        .add_option_function<std::string>(
            "--eon",
            [&pi](const std::string& text) {
                if (text.size() != kPiLength || !isHex(text)) {
                    throw CLI::ValidationError("--eon",
                                               "takes a PI, four hexadecimal digits like D3C1, not \"" + text + "\"");
                }
                pi = upperCase(text);
            },
            "the other network that EON keys and questions are about; in a shell also for the lines after; else "
            "the one sent last, or that of data set 1")
        ->type_name("PI");
}

}  // namespace kdx::ctl
