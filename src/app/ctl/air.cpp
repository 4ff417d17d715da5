#include <CLI/CLI.hpp>

#include <fstream>
#include <iostream>
#include <memory>

#include "air/broadcast.h"
#include "app/ctl/aircommands.h"
#include "app/ctl/laboratory.h"
#include "base/duration.h"

namespace kdx::ctl {

namespace {

using namespace std::chrono_literals;

constexpr std::string_view kStandardOutput = "-";

struct Air : AirCommands {
    std::string groupFile;
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
    what->addTo(*command);
    addTimes(*command, what);
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
