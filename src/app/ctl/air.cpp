#include <CLI/CLI.hpp>

#include <fstream>
#include <iostream>
#include <memory>
#include <optional>

#include "air/broadcast.h"
#include "air/multiplexfile.h"
#include "app/ctl/aircommands.h"
#include "app/ctl/laboratory.h"
#include "app/ctl/secondsoption.h"
#include "base/paths.h"
#include "settings/shownpath.h"

namespace kdx::ctl {

namespace {

using namespace std::chrono_literals;
using Commands = std::vector<air::TimedCommand>;

constexpr std::string_view kStandardOutput = "-";

struct Air : AirCommands {
    std::string groupFile;
    std::string multiplexFile;
    int rate = air::kMultiplexRate;
    air::SampleFormat format = air::SampleFormat::Float;
    std::chrono::milliseconds duration = 60s;
    std::optional<air::AirTime> start;
};

/// Where the lines of groups go.
class GroupLines {
public:
    GroupLines(Laboratory& laboratory, const std::string& file)
        : m_isOutput(file == kStandardOutput),
          m_isSilent(m_isOutput && laboratory.call().json),
          m_document(laboratory.output().document) {
        if (!m_isOutput) m_file.open(pathFromUtf8(file), std::ios::binary);
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

bool areSame(const std::string& one, const std::string& other) {
    return isSameFile(pathFromUtf8(one), pathFromUtf8(other));
}

/// What is on the air, group by group, until its time is over or the user wants to stop.
class Recording {
public:
    Recording(Laboratory& laboratory, const Air& what, const Commands& commands)
        : m_laboratory(laboratory),
          m_what(what),
          m_start(what.start.value_or(air::airTimeOf(SystemClock()))),
          m_commands(commands),
          m_broadcast(m_start, [&laboratory](const std::string& text) { laboratory.output().warning(text); }) {
        if (!what.groupFile.empty()) m_lines.emplace(laboratory, what.groupFile);
        if (!what.multiplexFile.empty())
            m_multiplex.emplace(what.multiplexFile, what.rate, what.format, air::Ticks{what.duration} + kTail);
    }

    /// @returns the exit code.
    int run() {
        air::OnAir sent;
        bool hadGroups = false;
        executeDueCommands();
        for (auto left = air::Ticks{m_what.duration} / air::kGroupTime; left > 0 && goesOn(); --left) {
            executeDueCommands();
            sent = m_broadcast.next();
            hadGroups = hadGroups || sent.kind == air::OnAir::Kind::Group;
            if (m_lines && sent.kind == air::OnAir::Kind::Group)
                m_lines->add(air::logLine(sent.group, m_broadcast.time()));
            if (m_multiplex) m_multiplex->add(sent, m_broadcast.transmission().settings);
        }
        if (m_multiplex) endMultiplex(sent);
        if (goesOn()) tellWhatIsMissing(hadGroups);
        bool isWritten = isOrTold(!m_multiplex || m_multiplex->close(), m_what.multiplexFile);
        isWritten = isOrTold(!m_lines || m_lines->finish(), m_what.groupFile) && isWritten;
        return isWritten ? m_laboratory.result() : kFailed;
    }

private:
    static constexpr air::Ticks kTail = 200ms;  ///< after the last group, for the filters of a receiver

    void executeDueCommands() {
        for (; m_done < m_commands.size() && m_start + m_commands[m_done].after <= m_broadcast.time(); ++m_done) {
            if (m_laboratory.isStopped()) return;
            m_broadcast.execute(m_commands[m_done].command, m_start + m_commands[m_done].after);
        }
    }
    /// What the user will have wanted otherwise.
    void tellWhatIsMissing(bool hadGroups) {
        Output& output = m_laboratory.output();
        if (!hadGroups) output.warning("no group goes out: RDS is off, or a test pattern on");
        if (m_multiplex && !m_broadcast.transmission().settings.stereoOn)
            output.warning("the stereo coder is off: the multiplex is silent");
        if (const std::size_t left = m_commands.size() - m_done; left > 0)
            output.warning("commands that come after the end are left out: " + std::to_string(left));
    }
    [[nodiscard]] bool goesOn() { return !m_laboratory.isStopped() && (!m_multiplex || m_multiplex->good()); }

    /// Groups end whole; what else goes out lasts as long as was asked for.
    void endMultiplex(const air::OnAir& last) {
        if (!goesOn()) return;
        const bool isGroup = last.kind == air::OnAir::Kind::Group;
        m_multiplex->goOn(isGroup ? air::OnAir{} : last, m_broadcast.transmission().settings,
                          isGroup ? m_broadcast.time() - m_start + kTail : air::Ticks{m_what.duration});
        m_laboratory.output().document["samples"] = m_multiplex->samples();
    }

    [[nodiscard]] bool isOrTold(bool isWritten, const std::string& file) {
        if (!isWritten) m_laboratory.output().problem(file + " cannot be written");
        return isWritten;
    }

    Laboratory& m_laboratory;
    const Air& m_what;
    air::AirTime m_start;
    const Commands& m_commands;
    std::size_t m_done = 0;
    air::Broadcast m_broadcast;
    std::optional<GroupLines> m_lines;
    std::optional<air::MultiplexFile> m_multiplex;
};

int onAir(Laboratory& laboratory, const Air& what) {
    if (what.groupFile.empty() && what.multiplexFile.empty()) {
        laboratory.output().problem("nothing to write: give --groups FILE, --mpx FILE or both");
        return kWrongCall;
    }
    if (what.multiplexFile == kStandardOutput) {
        laboratory.output().problem("--mpx takes a file: a WAV file cannot be written to the standard output");
        return kWrongCall;
    }
    for (const std::string& written : {what.groupFile, what.multiplexFile}) {
        const bool isRead =
            areSame(written, what.log) || areSame(written, what.commandFile) || areSame(written, what.source.file);
        if (!isRead && !areSame(what.groupFile, what.multiplexFile)) continue;
        laboratory.output().problem(written + " is named twice: it cannot be written and be something else");
        return kWrongCall;
    }
    const auto commands = commandsOf(laboratory, what);
    return commands ? Recording(laboratory, what, *commands).run() : kWrongCall;
}

void addTimes(CLI::App& command, const std::shared_ptr<Air>& what) {
    addSeconds(command, {"--seconds", 1ms, 24h, "up to 86400", "how much of it, 60 when nothing is said"},
               [what](std::chrono::milliseconds time) { what->duration = time; });
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

void addFiles(CLI::App& command, const std::shared_ptr<Air>& what) {
    command.add_option("--groups", what->groupFile, "write the groups there, - for the standard output")
        ->type_name("FILE");
    command.add_option("--mpx", what->multiplexFile, "write the stereo multiplex there, a WAV file")->type_name("FILE");
    command.add_option("--rate", what->rate, "its samples a second, 228000 when nothing is said")
        ->check(CLI::IsMember({air::kMultiplexRate, air::kLowMultiplexRate}))
        ->type_name("228000|192000");
    command
        .add_option_function<std::string>(
            "--format",
            [what](const std::string& text) {
                what->format = text == "s16" ? air::SampleFormat::SixteenBit : air::SampleFormat::Float;
            },
            "its samples, float when nothing is said")
        ->check(CLI::IsMember({"float", "s16"}))
        ->type_name("float|s16");
}

}  // namespace

void addAir(CLI::App& app, Task& task) {
    auto what = std::make_shared<Air>();
    CLI::App* command = app.add_subcommand("air", "Write what the virtual coder would transmit with a data set");
    what->addTo(*command);
    addTimes(*command, what);
    addFiles(*command, what);
    command->footer(
        "Without a data set the instrument is as after switching on.\n"
        "Example: kdx-ctl air --data-set 2 --seconds 10 --groups - --mpx multiplex.wav");
    command->callback([what, &task] { task = [what](Laboratory& laboratory) { return onAir(laboratory, *what); }; });
}

}  // namespace kdx::ctl
