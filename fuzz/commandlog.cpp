// Command logs: what was logged as sent is found again, whatever stands around it.
#include "harness.h"

#include "coder/loggedcommands.h"

#include <algorithm>

int LLVMFuzzerTestOneInput(const std::uint8_t* data, std::size_t size) {
    using kdx::fuzz::demand;
    FuzzedDataProvider input(data, size);
    std::string command = kdx::fuzz::nextText(input);
    const std::string before = input.ConsumeRemainingBytesAsString();
    std::erase_if(command, [](char c) { return c == '\r' || c == '\n'; });

    const auto found = kdx::readLoggedCommands(before);
    const auto lines = static_cast<std::size_t>(std::count(before.begin(), before.end(), '\n')) + 1;
    demand(found.commands.size() + found.unreadableLines.size() <= lines, "a line is one command at most");
    for (const std::size_t line : found.unreadableLines) demand(line >= 1 && line <= lines, "lines count from 1");

    // An answer that does not end swallows what follows it, so a whole line comes between.
    const auto again = kdx::readLoggedCommands(before + "\"\r\n             TP= \"" + command + "\"\r\n");
    demand(!again.commands.empty() && again.commands.back() == std::pair<std::string, std::string>("TP", command),
           "the command logged last is found");
    return 0;
}
