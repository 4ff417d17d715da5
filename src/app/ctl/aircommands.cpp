#include "app/ctl/aircommands.h"

#include <CLI/CLI.hpp>

#include "app/ctl/laboratory.h"
#include "app/ctl/readablefile.h"
#include "coder/loggedcommands.h"
#include "station/rehearsal.h"

namespace kdx::ctl {

namespace {

using Commands = std::vector<air::TimedCommand>;

/// Adds what a data set makes of an instrument.
bool addDataSet(Laboratory& laboratory, const WhichDataSet& source, Commands& commands) {
    const auto profile = source.profile(laboratory);
    if (!profile) return false;
    Rehearsal rehearsal(laboratory.data(), laboratory.captions());
    rehearsal.apply(*profile);
    for (const std::string& command : rehearsal.commands()) commands.push_back({air::Ticks{0}, command});
    return true;
}

bool addLog(Laboratory& laboratory, const std::string& file, Commands& commands) {
    const auto bytes = bytesOf(laboratory.output(), file);
    if (!bytes) return false;
    const LoggedCommands logged = readLoggedCommands(*bytes);
    for (const auto& [key, command] : logged.commands) commands.push_back({air::Ticks{0}, command});
    return areNone(laboratory.output(), file, logged.unreadableLines, "not a line of a command log");
}

bool addCommandFile(Laboratory& laboratory, const std::string& file, Commands& commands) {
    const auto bytes = bytesOf(laboratory.output(), file);
    if (!bytes) return false;
    const air::TimedCommands read = air::readTimedCommands(*bytes);
    commands.insert(commands.end(), read.commands.begin(), read.commands.end());
    return areNone(laboratory.output(), file, read.unreadableLines, "not a line of a command file");
}

}  // namespace

void AirCommands::addTo(CLI::App& command) {
    source.addTo(command);
    command.add_option("--log", log, "carry out the commands of a command log too")->type_name("LOG");
    command
        .add_option("--commands", commandFile,
                    "carry out a command a line too; \"@ 2.5 \" before it: 2.5 s after the start")
        ->type_name("FILE");
}

std::optional<Commands> commandsOf(Laboratory& laboratory, const AirCommands& what) {
    Commands commands;
    if (what.source.isNamed() && !addDataSet(laboratory, what.source, commands)) return std::nullopt;
    if (!what.log.empty() && !addLog(laboratory, what.log, commands)) return std::nullopt;
    if (!what.commandFile.empty() && !addCommandFile(laboratory, what.commandFile, commands)) return std::nullopt;
    return commands;
}

}  // namespace kdx::ctl
