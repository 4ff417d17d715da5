// Command logs: what was logged as sent is found again, whatever stands around it.
#include "harness.h"

#include "coder/loggedcommands.h"
#include "coder/sendparam.h"

#include <algorithm>

int LLVMFuzzerTestOneInput(const std::uint8_t* data, std::size_t size) {
    using kdx::fuzz::demand;
    FuzzedDataProvider input(data, size);
    std::string command = kdx::fuzz::nextText(input);
    const std::string before = input.ConsumeRemainingBytesAsString();
    std::erase_if(command, [](char c) { return c == '\r' || c == '\n'; });

    // What the coder is sent stands in quotes; a line without the closing one has been cut.
    constexpr std::string_view kPassedOn = ":STEREO:DIRECT ";
    if (command.starts_with(kPassedOn)) command = kdx::coderCommand(command.substr(kPassedOn.size()));

    const auto found = kdx::readLoggedCommands(before);
    const auto lines = static_cast<std::size_t>(std::count(before.begin(), before.end(), '\n')) + 1;
    demand(found.commands.size() + found.unreadableLines.size() <= lines, "a line is one command at most");
    for (const std::size_t line : found.unreadableLines) demand(line >= 1 && line <= lines, "lines count from 1");

    // What stands before may end in the middle of a line.
    const auto again = kdx::readLoggedCommands(before + "\"\r\n             TP= \"" + command + "\"\r\n");
    demand(!again.commands.empty() && again.commands.back() == std::pair<std::string, std::string>("TP", command),
           "the command logged last is found");
    return 0;
}
