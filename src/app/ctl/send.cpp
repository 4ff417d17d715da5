#include <CLI/CLI.hpp>

#include <memory>
#include <utility>
#include <vector>

#include "af/settings.h"
#include "app/ctl/laboratory.h"
#include "base/codepage.h"
#include "coder/sendparam.h"
#include "settings/withoutcontrols.h"

namespace kdx::ctl {

namespace {

struct Send {
    std::vector<std::string> settings;
    std::vector<std::string> raw;
    std::vector<std::string> coder;
};

/// What is typed on a command line, as one line of the instrument's characters.
std::string line(const std::string& utf8) {
    return fromUtf8(withoutControls(utf8));
}

/// Whether a command as it stands can go out; what is wrong is told.
bool isLegal(Laboratory& laboratory, const std::string& command, bool forCoder) {
    if (laboratory.call().force) return true;
    std::string why;
    if (const std::string_view foreign = firstOutsideCodePage(command); !foreign.empty()) {
        why = noSuchCharacter(foreign);
    } else if (forCoder && endsItsTextEarly(coderCommand(line(command)))) {
        why = "a double quote ends it early";
    }
    if (why.empty()) return true;
    laboratory.output().problem((forCoder ? "the coder command " : "the command ") + command +
                                " cannot be sent: " + why);
    return false;
}

int send(Laboratory& laboratory, const Send& what) {
    std::vector<std::pair<std::string, std::string>> settings;
    bool legal = true;
    for (const std::string& text : what.settings) {
        const std::size_t equals = text.find('=');
        if (equals == std::string::npos) {
            laboratory.output().problem(text + " is not KEY=VALUE");
            return kWrongCall;
        }
        const std::string value = withoutControls(text.substr(equals + 1));
        settings.emplace_back(text.substr(0, equals), fromUtf8(value));
        legal = laboratory.mayBeSent(settings.back().first, value) && legal;
    }
    for (const std::string& command : what.raw) legal = isLegal(laboratory, command, false) && legal;
    for (const std::string& command : what.coder) legal = isLegal(laboratory, command, true) && legal;
    if (!legal) return kWrongCall;
    if (!laboratory.open()) return kNoConnection;
    Session& session = laboratory.session();
    for (const auto& [key, value] : settings) {
        // Commands about the other network are led by the one that was sent last.
        if (key == setting::kEonPi.sendKey) laboratory.state().eonIdentifier = value;
        if (laboratory.goesOn()) session.params.SendParam(key, std::string(value));
    }
    const auto sendCommand = [&](const std::string& command) {
        if (laboratory.goesOn()) session.params.sendCommand({}, command);
    };
    for (const std::string& command : what.raw) sendCommand(line(command));
    for (const std::string& command : what.coder) sendCommand(coderCommand(line(command)));
    laboratory.close();
    return laboratory.result();
}

}  // namespace

void addSend(CLI::App& app, Task& task) {
    auto what = std::make_shared<Send>();
    CLI::App* command = app.add_subcommand("send", "Send single settings by their keys, or commands as they stand");
    command->add_option("settings", what->settings, "keys of the key table (kdx-ctl list keys) with their values")
        ->type_name("KEY=VALUE");
    command->add_option("--raw", what->raw, "an instrument command as it stands")
        ->type_name("TEXT")
        ->allow_extra_args(false);
    command->add_option("--coder", what->coder, "a coder command")->type_name("TEXT")->allow_extra_args(false);
    command->require_option(1, 0);
    command->footer("Example: kdx-ctl send PS=MESSTURM TP=1 HF-Frequenz=98.5");
    command->callback([what, &task] { task = [what](Laboratory& laboratory) { return send(laboratory, *what); }; });
}

}  // namespace kdx::ctl
