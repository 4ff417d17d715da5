#include <CLI/CLI.hpp>

#include <memory>

#include "app/ctl/laboratory.h"
#include "coder/loggedcommands.h"
#include "settings/profilefile.h"

namespace kdx::ctl {

namespace {

struct Replay {
    std::string log;
    bool check = false;
};

int replay(Laboratory& laboratory, const Replay& what) {
    const auto bytes = readFile(what.log);
    if (!bytes) {
        laboratory.output().problem(what.log + " cannot be read");
        return kWrongCall;
    }
    const LoggedCommands logged = readLoggedCommands(*bytes);
    for (const std::size_t line : logged.unreadableLines)
        laboratory.output().problem(what.log + ", line " + std::to_string(line) + ": not a line of a command log");
    if (!laboratory.call().force) {
        for (const std::size_t line : logged.quotedLines) {
            laboratory.output().problem(what.log + ", line " + std::to_string(line) +
                                        ": a double quote ends the coder command early");
        }
    }
    if (!logged.unreadableLines.empty() || (!logged.quotedLines.empty() && !laboratory.call().force)) return kWrongCall;
    laboratory.output().document["commands"] = logged.commands.size();
    if (what.check) {
        laboratory.output().line(std::to_string(logged.commands.size()) + " commands");
        return kDone;
    }
    if (!laboratory.open()) return kNoConnection;
    Session& session = laboratory.session();
    laboratory.expect(logged.commands.size());
    for (const auto& [key, command] : logged.commands) {
        if (!laboratory.goesOn()) break;
        session.params.sendCommand(key, command);
    }
    session.close();
    return laboratory.result();
}

}  // namespace

void addReplay(CLI::App& app, Task& task) {
    auto what = std::make_shared<Replay>();
    CLI::App* command = app.add_subcommand("replay", "Send the commands of a command log in their order");
    command->add_option("log", what->log, "a command log (RDS_log.txt)")->required()->type_name("LOG");
    command->add_flag("--check", what->check, "only read the log");
    command->footer(
        "Every run appends to the data folder's RDS_log.txt, so send a copy of what is to be kept.\n"
        "Example: kdx-ctl replay drive.log");
    command->callback([what, &task] { task = [what](Laboratory& laboratory) { return replay(laboratory, *what); }; });
}

}  // namespace kdx::ctl
