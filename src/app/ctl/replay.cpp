#include <CLI/CLI.hpp>

#include <memory>

#include "app/ctl/laboratory.h"
#include "app/ctl/readablefile.h"
#include "coder/loggedcommands.h"

namespace kdx::ctl {

namespace {

struct Replay {
    std::string log;
    bool check = false;
};

int replay(Laboratory& laboratory, const Replay& what) {
    Output& output = laboratory.output();
    const auto bytes = bytesOf(output, what.log);
    if (!bytes) return kWrongCall;
    const LoggedCommands logged = readLoggedCommands(*bytes);
    const bool whole = areNone(output, what.log, logged.unreadableLines, "not a line of a command log");
    const bool legal = laboratory.call().force ||
                       areNone(output, what.log, logged.quotedLines, "a double quote ends the coder command early");
    if (!whole || !legal) return kWrongCall;
    output.document["commands"] = logged.commands.size();
    if (what.check) {
        output.line(std::to_string(logged.commands.size()) + " commands");
        return kDone;
    }
    if (!laboratory.open()) return kNoConnection;
    Session& session = laboratory.session();
    laboratory.expect(logged.commands.size());
    for (const auto& [key, command] : logged.commands) {
        if (!laboratory.goesOn()) break;
        session.params.sendCommand(key, command);
    }
    laboratory.close();
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
