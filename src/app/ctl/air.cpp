#include <CLI/CLI.hpp>

#include <fstream>
#include <iostream>
#include <memory>

#include "air/broadcast.h"
#include "air/timedcommands.h"
#include "app/ctl/laboratory.h"
#include "app/ctl/readablefile.h"
#include "app/ctl/whichdataset.h"
#include "base/duration.h"
#include "coder/loggedcommands.h"
#include "station/rehearsal.h"

namespace kdx::ctl {

namespace {

using namespace std::chrono_literals;

constexpr std::string_view kStandardOutput = "-";

struct Air {
    WhichDataSet source;
    bool appliesSource = false;
    std::string log;
    std::string commandFile;
    std::string groupFile;
    std::chrono::milliseconds duration = 60s;
    std::optional<air::AirTime> start;
};

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

/// All that is done to the instrument, in its order; nothing when a part of it cannot be read.
std::optional<Commands> commandsOf(Laboratory& laboratory, const Air& what) {
    Commands commands;
    if (what.appliesSource && !addDataSet(laboratory, what.source, commands)) return std::nullopt;
    if (!what.log.empty() && !addLog(laboratory, what.log, commands)) return std::nullopt;
    if (!what.commandFile.empty() && !addCommandFile(laboratory, what.commandFile, commands)) return std::nullopt;
    return commands;
}

/// Where the lines of groups go.
class GroupLines {
public:
    GroupLines(Laboratory& laboratory, const std::string& file)
        : m_isOutput(file == kStandardOutput),
          m_isSilent(m_isOutput && laboratory.call().json),
          m_document(laboratory.output().document) {
        if (!m_isOutput) m_file.open(file, std::ios::binary);
        if (m_isSilent) m_document["lines"] = nlohmann::json::array();
    }

    void add(const std::string& line) {
        ++m_count;
        if (m_isSilent) {
            m_document["lines"].push_back(line);
        } else {
            stream() << line << '\n';
        }
    }
    /// Whether all could be written.
    [[nodiscard]] bool finish() {
        m_document["groups"] = m_count;
        return stream().flush().good();
    }

private:
    std::ostream& stream() { return m_isOutput ? std::cout : m_file; }

    bool m_isOutput;
    bool m_isSilent;
    nlohmann::json& m_document;
    std::ofstream m_file;
    std::size_t m_count = 0;
};

int onAir(Laboratory& laboratory, const Air& what) {
    const auto commands = commandsOf(laboratory, what);
    if (!commands) return kWrongCall;
    const air::AirTime start = what.start.value_or(air::airTimeOf(SystemClock()));
    air::Broadcast broadcast(start, [&laboratory](const std::string& text) { laboratory.output().warning(text); });
    GroupLines lines(laboratory, what.groupFile);
    auto command = commands->begin();
    for (auto left = air::Ticks{what.duration} / air::kGroupTime; left > 0 && !laboratory.isStopped(); --left) {
        for (; command != commands->end() && start + command->after <= broadcast.time(); ++command)
            broadcast.execute(command->command, start + command->after);
        const air::OnAir sent = broadcast.next();
        if (sent.kind == air::OnAir::Kind::Group) lines.add(air::logLine(sent.group, broadcast.time()));
    }
    if (lines.finish()) return laboratory.result();
    laboratory.output().problem(what.groupFile + " cannot be written");
    return kFailed;
}

void addTimes(CLI::App& command, const std::shared_ptr<Air>& what) {
    command
        .add_option_function<std::string>(
            "--seconds",
            [what](const std::string& text) {
                const auto duration = parseDuration(text + " s");
                if (!duration || *duration <= 0s || *duration > 24h)
                    throw CLI::ValidationError("--seconds", "takes up to 86400 seconds, not \"" + text + "\"");
                what->duration = *duration;
            },
            "how much of it, 60 when nothing is said")
        ->type_name("SECONDS");
    command
        .add_option_function<std::string>(
            "--start",
            [what](const std::string& text) {
                what->start = air::parseAirTime(text);
                if (!what->start) {
                    throw CLI::ValidationError("--start",
                                               "takes a time like \"2026-01-01 12:00:00\", not \"" + text + "\"");
                }
            },
            "when it begins, else now")
        ->type_name("TIME");
}

}  // namespace

void addAir(CLI::App& app, Task& task) {
    auto what = std::make_shared<Air>();
    CLI::App* command = app.add_subcommand("air", "Write what the virtual coder would transmit with a data set");
    what->source.addTo(*command);
    addTimes(*command, what);
    command->add_option("--log", what->log, "carry out the commands of a command log too")->type_name("LOG");
    command
        ->add_option("--commands", what->commandFile,
                     "carry out a command a line too; \"@ 2.5 \" before it: 2.5 s after the start")
        ->type_name("FILE");
    command->add_option("--groups", what->groupFile, "write the groups there, - for the standard output")
        ->required()
        ->type_name("FILE");
    command->footer(
        "Without a data set the instrument is as after switching on.\n"
        "Example: kdx-ctl air --data-set 2 --seconds 10 --groups -");
    command->callback([what, command, &task] {
        what->appliesSource = command->count("--data-set") + command->count("--file") > 0;
        task = [what](Laboratory& laboratory) { return onAir(laboratory, *what); };
    });
}

}  // namespace kdx::ctl
