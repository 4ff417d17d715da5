#include <CLI/CLI.hpp>

#include <algorithm>
#include <array>
#include <memory>
#include <sstream>

#include "app/ctl/completion.h"
#include "app/ctl/laboratory.h"
#include "app/ctl/lines.h"
#include "app/ctl/prompt.h"
#include "app/platform.h"
#include "base/duration.h"
#include "base/split.h"

namespace kdx::ctl {

namespace {

/// The subcommands that a line may call besides the shell's own.
constexpr std::array<AddSubcommand, 4> kSubcommands = {addSend, addQuery, addDiff, addRead};

int wait(Laboratory& laboratory, const std::vector<std::string>& words) {
    const std::string text = joined(words, " ");
    const auto duration = parseDuration(text);
    constexpr std::chrono::hours kLongest{168};
    if (!duration || *duration > kLongest) {
        laboratory.output().problem("\"" + text + "\" is no time; wait 2 s, 500 ms, 1.5 min or 1 h, a week at most");
        return kWrongCall;
    }
    return laboratory.pause(*duration) ? kDone : kFailed;
}

void addWait(CLI::App& app, Task& task) {
    auto words = std::make_shared<std::vector<std::string>>();
    CLI::App* command = app.add_subcommand("wait", "Wait before the next line");
    command->add_option("time", *words, "2 s, 500 ms, 1.5 min, 1 h")->required()->type_name("TIME");
    command->footer("Example: wait 500 ms");
    command->callback([words, &task] { task = [words](Laboratory& laboratory) { return wait(laboratory, *words); }; });
}

void tellHelp(Laboratory& laboratory, const std::string& text) {
    laboratory.output().line(text);
    laboratory.output().document["help"] = text;
}

/// What can be called on a line, made anew for each.
class LineCommands {
public:
    LineCommands() {
        for (const AddSubcommand add : kSubcommands) add(m_app, m_task);
        addWait(m_app, m_task);
        addHelp();
        m_app.add_subcommand("quit", "Close the session and end")->alias("exit")->callback([this] {
            m_task = [](Laboratory&) { return kDone; };
            m_quits = true;
        });
        m_app.require_subcommand(1);
    }
    LineCommands(const LineCommands&) = delete;
    LineCommands& operator=(const LineCommands&) = delete;

    int run(Laboratory& laboratory, std::vector<std::string> words) {
        if (words.empty()) return kDone;
        if (commandNamed(m_app, words.front()) == nullptr) {
            laboratory.output().problem("there is no command " + words.front() + "; help lists them");
            return kWrongCall;
        }
        std::reverse(words.begin(), words.end());  // as the parser wants them
        try {
            m_app.parse(std::move(words));
        } catch (const CLI::CallForHelp& called) {
            std::ostringstream help;
            m_app.exit(called, help, help);
            tellHelp(laboratory, help.str());
            return kDone;
        } catch (const CLI::ParseError& error) {
            laboratory.output().problem(error.what());
            return kWrongCall;
        }
        return m_task(laboratory);
    }
    [[nodiscard]] bool quits() const { return m_quits; }
    [[nodiscard]] const CLI::App& app() const { return m_app; }

private:
    void addHelp() {
        CLI::App* command = m_app.add_subcommand("help", "List the commands, or tell more about one");
        command->add_option("command", m_helpFor, "a command of the shell")->type_name("COMMAND");
        command->callback([this] { m_task = [this](Laboratory& laboratory) { return help(laboratory); }; });
    }

    int help(Laboratory& laboratory) {
        const CLI::App* about = commandNamed(m_app, m_helpFor);
        if (!m_helpFor.empty() && about == nullptr) {
            laboratory.output().problem("there is no command " + m_helpFor + "; help lists them");
            return kWrongCall;
        }
        if (about != nullptr) {
            tellHelp(laboratory, about->help());
            return kDone;
        }
        std::string text;
        for (const CLI::App* command : m_app.get_subcommands({})) {
            std::string name = command->get_name();
            name.resize(std::max<std::size_t>(name.size() + 2, 8), ' ');
            text += name + command->get_description() + "\n";
        }
        tellHelp(laboratory, text + "help COMMAND says more. Quotes hold blanks together, # begins a comment.");
        return kDone;
    }

    CLI::App m_app;
    Task m_task;
    std::string m_helpFor;
    bool m_quits = false;
};

/// @returns what came of the line.
int runLine(Laboratory& laboratory, const Line& line, bool& quits) {
    Output& output = laboratory.output();
    const auto words = wordsOf(line.text);
    const std::string problem = words ? line.problem : "a quote is not closed";
    if (!problem.empty()) {
        output.problem(problem);
        return kWrongCall;
    }
    try {
        LineCommands commands;
        const int result = commands.run(laboratory, *words);
        quits = commands.quits();
        return result;
    } catch (const std::exception& error) {
        output.problem(error.what());
        return kFailed;
    }
}

std::unique_ptr<LineSource> prompt(int stop) {
    const auto complete = [](const std::string& begun) { return completions(LineCommands().app(), begun); };
    return std::make_unique<PromptedLines>("kdx> ", stop, complete);
}

int shell(Laboratory& laboratory) {
    laboratory.output().answerLines();
    if (!laboratory.open()) {
        (void)laboratory.output().endLine(kNoConnection);  // an answer before any line
        return kNoConnection;
    }
    laboratory.hold();
    const bool prompted = inputIsTerminal() && outputIsTerminal() && !laboratory.call().json;
    const auto lines = prompted ? prompt(laboratory.stop()) : std::make_unique<PipedLines>(laboratory.stop());
    int worst = kDone;
    bool quits = false;
    bool isRead = true;
    for (std::size_t number = 1; !quits && isRead && !laboratory.isStopped(); ++number) {
        const auto line = lines->next();
        if (!line) break;
        laboratory.output().beginLine(number, prompted ? "" : "line " + std::to_string(number) + ": ");
        laboratory.nextTask();
        const int result = runLine(laboratory, *line, quits);
        isRead = laboratory.output().endLine(result);
        worst = std::max(worst, result);
    }
    if (!isRead) laboratory.output().problem("the answers cannot be written any more");
    // What goes wrong with a command is told on a terminal; the exit code is for programs.
    if (laboratory.isStopped() || !isRead) return std::max(worst, kFailed);
    return prompted ? kDone : worst;
}

}  // namespace

void addShell(CLI::App& app, Task& task) {
    CLI::App* command = app.add_subcommand("shell", "Keep one session open and run a command a line");
    command->footer(
        "A line is \"send KEY=VALUE ...\", \"query NAME ...\", \"diff\", \"read\", \"wait 2 s\", \"help\" or \"quit\". "
        "Quotes, double or "
        "single,\n"
        "hold blanks together; # begins a comment. At a prompt the Tab key completes, the arrow keys bring lines "
        "back;\n"
        "Ctrl-C and Ctrl-D end, also there. From a pipe every line is answered before the next one is read; a line "
        "that\n"
        "fails does not end the run. With --json there is exactly one JSON object a line of input, on one line. A "
        "link\n"
        "that is lost is told once; with the next line a new one is tried.\n"
        "Exit code: the greatest that a line had; 0 at a prompt.\n"
        "Example: kdx-ctl shell\n"
        "Through a pipe: printf 'send PS=RADIO\\nquery ps\\n' | kdx-ctl shell");
    command->callback([&task] { task = shell; });
}

}  // namespace kdx::ctl
