#include <CLI/CLI.hpp>

#include <algorithm>
#include <memory>
#include <optional>
#include <utility>
#include <vector>

#include "af/settings.h"
#include "app/ctl/laboratory.h"
#include "app/ctl/othernetwork.h"
#include "base/codepage.h"
#include "coder/keyfacts.h"
#include "coder/sendparam.h"
#include "link/commandsequence.h"
#include "settings/withoutcontrols.h"
#include "sim/scpi.h"

namespace kdx::ctl {

namespace {

struct Send {
    std::vector<std::string> settings;
    std::vector<std::string> raw;
    std::vector<std::string> coder;
    std::optional<std::string> otherNetwork;
};

/// A setting as it is typed, cut in two. Nothing when it has no value and its key needs one, which is told.
std::optional<std::pair<std::string, std::string>> keyAndValue(Laboratory& laboratory, const std::string& text) {
    const std::size_t equals = text.find('=');
    if (equals != std::string::npos) return std::pair(text.substr(0, equals), withoutControls(text.substr(equals + 1)));
    const KeyFacts* facts = factsOf(text);
    if (facts != nullptr && facts->range.empty()) return std::pair(text, std::string());  // its value says nothing
    laboratory.output().problem(text + " is not KEY=VALUE");
    return std::nullopt;
}

/// Whether the instrument answers the command, or a part of it.
bool isQuestion(const std::string& command) {
    const auto units = sim::splitOutsideQuotes(command, ';');
    return std::any_of(units.begin(), units.end(), [](std::string_view unit) { return sim::readUnit(unit).query; });
}

/// Sends a command as it stands. An answer is shown: left unread it would be taken for that of the next question.
void sendAsItStands(Laboratory& laboratory, const std::string& command) {
    if (!laboratory.goesOn()) return;
    Session& session = laboratory.session();
    if (!isQuestion(command)) return session.params.sendCommand({}, command);
    const CommandSequence sequence(session.instrument);
    const auto answer = session.instrument.ask(command, false);
    if (!answer) return;
    laboratory.output().line(toUtf8(*answer));
    laboratory.output().document["answers"].push_back(toUtf8(*answer));
}

/// What is typed on a command line, as one line of the instrument's characters.
std::string line(const std::string& utf8) {
    return fromUtf8(withoutControls(utf8));
}

/// A command for the coder as it goes out.
std::string forTheCoder(Laboratory& laboratory, const std::string& utf8) {
    const std::string command = coderCommand(line(utf8));
    return laboratory.state().corrections.quotes ? quotesDoubled(command) : command;
}

/// Whether a command as it stands can go out; what is wrong is told.
bool isLegal(Laboratory& laboratory, const std::string& command, bool forCoder) {
    if (laboratory.call().force) return true;
    std::string why;
    if (const std::string_view foreign = firstOutsideCodePage(command); !foreign.empty()) {
        why = noSuchCharacter(foreign);
    } else if (forCoder && endsItsTextEarly(forTheCoder(laboratory, command))) {
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
        const auto setting = keyAndValue(laboratory, text);
        if (!setting) return kWrongCall;
        const auto& [key, value] = *setting;
        settings.emplace_back(key, fromUtf8(value));
        legal = laboratory.mayBeSent(key, value) && legal;
    }
    for (const std::string& command : what.raw) legal = isLegal(laboratory, command, false) && legal;
    for (const std::string& command : what.coder) legal = isLegal(laboratory, command, true) && legal;
    if (!legal) return kWrongCall;
    if (!laboratory.open()) return kNoConnection;
    Session& session = laboratory.session();
    if (what.otherNetwork) laboratory.state().eonIdentifier = *what.otherNetwork;
    for (const auto& [key, value] : settings) {
        // Commands about the other network are led by the one that was sent last.
        if (key == setting::kEonPi.sendKey) laboratory.state().eonIdentifier = value;
        if (laboratory.goesOn())
            session.params.SendParam(key, correctedValue(key, value, laboratory.state().corrections));
    }
    for (const std::string& command : what.raw) sendAsItStands(laboratory, line(command));
    for (const std::string& command : what.coder) sendAsItStands(laboratory, forTheCoder(laboratory, command));
    laboratory.close();
    return laboratory.result();
}

}  // namespace

void addSend(CLI::App& app, Task& task) {
    auto what = std::make_shared<Send>();
    CLI::App* command = app.add_subcommand("send", "Send single settings by their keys, or commands as they stand");
    command->add_option("settings", what->settings, "keys of the key table (kdx-ctl list keys) with their values")
        ->type_name("KEY=VALUE");
    command
        ->add_option("--raw", what->raw, "an instrument command as it stands, after the settings; an answer is shown")
        ->type_name("TEXT")
        ->allow_extra_args(false);
    command->add_option("--coder", what->coder, "a coder command, after those")
        ->type_name("TEXT")
        ->allow_extra_args(false);
    addOtherNetwork(*command, what->otherNetwork);
    command->footer("Example: kdx-ctl send PS=MESSTURM TP=1 HF-Frequenz=98.5");
    command->callback([what, &task] {
        if (what->settings.empty() && what->raw.empty() && what->coder.empty())
            throw CLI::RequiredError("KEY=VALUE, --raw or --coder");
        task = [what](Laboratory& laboratory) { return send(laboratory, *what); };
    });
}

}  // namespace kdx::ctl
