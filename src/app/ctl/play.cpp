#include <CLI/CLI.hpp>

#include <memory>
#include <optional>

#include "app/ctl/laboratory.h"
#include "app/ctl/scenariofile.h"
#include "app/platform.h"
#include "base/paths.h"
#include "base/split.h"
#include "scenario/readoutrestorer.h"
#include "scenario/runner.h"

namespace kdx::ctl {

namespace {

using scenario::Action;
using scenario::Row;

struct Play {
    std::string file;
    std::string report;
    std::optional<std::string> from;
    std::optional<std::string> until;
    double speed = 1;
    bool yes = false;
};

/// The person at the command line.
class Console final : public scenario::Attendant, public scenario::Watcher {
public:
    Console(Laboratory& laboratory, bool yes) : m_laboratory(laboratory), m_yes(yes) {
        output().document["steps"] = nlohmann::json::array();
    }

    bool goesOn() override { return m_laboratory.goesOn(); }
    void forgetsTyped() override { forgetTypedInput(); }
    Return pressed() override {
        switch (takeInputLine()) {
            case InputLine::NotYet:
                return Return::NotYet;
            case InputLine::Whole:
                return Return::Pressed;
            case InputLine::Ended:
                break;
        }
        return Return::NoLonger;
    }
    void finishes() override { m_laboratory.finish(); }

    void begins(const std::string& step, const Action& action) override {
        output().endProgress();
        output().remark(timeText(m_laboratory.clock()) + "  " + step + "  " + describe(action));
        const bool asks = action.kind == Action::Kind::Pause || action.untilReturn;
        if (asks && !m_yes) output().prompt(action.text.empty() ? "Return ends this" : action.text + " (Return)");
    }
    void happened(const Row& row) override {
        if (m_laboratory.call().json) {
            output().document["steps"].push_back({{"time", row.time},
                                                  {"step", row.step},
                                                  {"key", row.key},
                                                  {"value", row.value},
                                                  {"command", row.command},
                                                  {"status", row.status},
                                                  {"answer", row.answer}});
        }
        if (row.status == scenario::kNotMet) {
            output().problem("step " + row.step + ": expected " + row.key + "=" + row.value + ", answered was \"" +
                             row.answer + "\"");
        } else if (row.status == scenario::kNoReturn && row.key == scenario::kPauseRow && m_laboratory.goesOn()) {
            output().problem("stopped: the input ended at the pause of step " + row.step);
        } else if (row.status == scenario::kReturn && row.key != scenario::kPauseRow) {
            output().line("step " + row.step + ": Return at " + row.key + "=" + row.value);
        }
    }
    void waits(std::chrono::nanoseconds length) override {
        const std::chrono::duration<double> now(m_laboratory.clock().secondsSinceMidnight());
        output().waiting(timeText(std::chrono::duration_cast<std::chrono::seconds>(now + length)));
    }
    void reportLost() override { output().problem("the report cannot be written any more; the run ends"); }
    void ended(const scenario::Outcome& outcome) override {
        output().endProgress();
        if (!outcome.restored) output().problem("what stood before could not be brought back");
        const char* const changed = outcome.restored ? "not as before: " : "perhaps not as before: ";
        if (!outcome.changed.empty()) output().problem(changed + joined(outcome.changed, ", "));
        if (!outcome.untold.empty()) {
            output().problem("not brought back, as the instrument did not tell them before: " +
                             joined(outcome.untold, ", "));
        }
        output().document["restored"] = outcome.restored;
        output().document["changed"] = outcome.changed;
        output().document["untold"] = outcome.untold;
        if (outcome.unmet > 0) {
            output().problem(std::to_string(outcome.unmet) +
                             (outcome.unmet == 1 ? " expectation was not met" : " expectations were not met"));
        }
        output().document["unmet"] = outcome.unmet;
        output().document["complete"] = outcome.complete;
    }

private:
    [[nodiscard]] Output& output() { return m_laboratory.output(); }

    Laboratory& m_laboratory;
    bool m_yes;
};

/// The step of that number; told when there is none.
bool readStep(Laboratory& laboratory, const scenario::Scenario& scenario, const std::optional<std::string>& text,
              std::optional<scenario::StepNumber>& number) {
    if (!text) return true;
    number = scenario::readStepNumber(*text);
    if (number && isStepOf(scenario, *number)) return true;
    laboratory.output().problem("there is no step \"" + *text + "\"; steps are named as 4, 4.2 or 4#3.2");
    return false;
}

std::optional<scenario::RunOptions> readOptions(Laboratory& laboratory, const scenario::Scenario& scenario,
                                                const Play& what) {
    scenario::RunOptions options;
    options.nobodyThere = what.yes;
    if (!readStep(laboratory, scenario, what.from, options.from)) return std::nullopt;
    if (!readStep(laboratory, scenario, what.until, options.until)) return std::nullopt;
    if (options.from && options.until && isBefore(*options.until, *options.from)) {
        laboratory.output().problem("step " + *what.until + " comes before step " + *what.from);
        return std::nullopt;
    }
    return options;
}

int result(const Laboratory& laboratory, const scenario::Outcome& outcome) {
    if (!outcome.complete || !outcome.restored || laboratory.result() != kDone) return kFailed;
    const bool asWanted = outcome.unmet == 0 && outcome.changed.empty() && outcome.untold.empty();
    return asWanted ? kDone : kDifferent;
}

int play(Laboratory& laboratory, const Play& what) {
    if (what.speed != 1 && !laboratory.call().program.simulate) {
        laboratory.output().problem("--speed is for rehearsals: it needs --simulate");
        return kWrongCall;
    }
    const auto scenario = readScenarioFile(laboratory, what.file);
    if (!scenario) return kWrongCall;
    const auto options = readOptions(laboratory, *scenario, what);
    if (!options) return kWrongCall;
    const scenario::Report report(pathFromUtf8(what.report.empty() ? scenario->report : what.report));
    laboratory.hasten(what.speed);
    if (!laboratory.open()) return kNoConnection;
    const auto fault = report.file().empty() ? std::nullopt : report.begin();
    if (fault) {
        laboratory.output().problem("the report " + utf8Of(report.file()) + " " + faultWords(*fault));
        laboratory.close();
        return kWrongCall;
    }
    Console console(laboratory, what.yes);
    scenario::ReadoutRestorer restorer(laboratory.session().instrument, laboratory.state().corrections);
    scenario::Surroundings with{laboratory.session(), laboratory.state(), laboratory.clock(), console, console};
    with.restorer = &restorer;
    if (!report.file().empty()) with.report = &report;
    const scenario::Outcome outcome = scenario::Runner(with).run(*scenario, *options);
    laboratory.close();
    return result(laboratory, outcome);
}

}  // namespace

void addPlay(CLI::App& app, Task& task) {
    auto what = std::make_shared<Play>();
    CLI::App* command = app.add_subcommand("play", "Play a scenario: send, wait, expect, sweep, with a report");
    command->add_option("scenario", what->file, "the scenario's file")->required()->type_name("SCENARIO.yaml");
    command->add_flag("--yes", what->yes, "nobody is there: pauses go on, nothing waits for Return");
    command->add_option("--speed", what->speed, "so many times as fast, on the virtual instrument only")
        ->check(CLI::Range(1, 1000))
        ->type_name("N");
    command->add_option("--from", what->from, "begin with this step: 4, 4.2, or in its third pass 4#3.2")
        ->type_name("STEP");
    command->add_option("--until", what->until, "end after this step")->type_name("STEP");
    command->add_option("--report", what->report, "the report's file (CSV), instead of the scenario's own")
        ->type_name("FILE");
    command->footer(
        "Exit codes: 0 done, 1 stopped or a command failed, 2 a mistake in the file or the call,\n"
        "3 an expectation was not met or something is not as before, 4 no connection.\n"
        "Example: kdx-ctl play Daten/Scenarios/af_handover.yaml --simulate --yes --speed 100 --report af.csv");
    command->callback([what, &task] { task = [what](Laboratory& laboratory) { return play(laboratory, *what); }; });
}

}  // namespace kdx::ctl
