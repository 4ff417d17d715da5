#include <CLI/CLI.hpp>

#include <memory>

#include "app/ctl/laboratory.h"
#include "app/ctl/scenariofile.h"

namespace kdx::ctl {

namespace {

int check(Laboratory& laboratory, const std::string& file) {
    const auto scenario = readScenarioFile(laboratory, file);
    if (!scenario) return kWrongCall;
    const std::string title = scenario->title.empty() ? file : scenario->title;
    const std::size_t steps = scenario->actions.size();
    laboratory.output().remark(title + ": " + std::to_string(steps) + (steps == 1 ? " step" : " steps"));
    laboratory.output().document["title"] = scenario->title;
    laboratory.output().document["steps"] = steps;
    return kDone;
}

}  // namespace

void addCheck(CLI::App& app, Task& task) {
    auto file = std::make_shared<std::string>();
    CLI::App* command = app.add_subcommand("check", "Only read a scenario; every mistake is told with its place");
    command->add_option("scenario", *file, "the scenario's file")->required()->type_name("SCENARIO.yaml");
    command->footer("Example: kdx-ctl check Daten/Scenarios/sensitivity.yaml");
    command->callback([file, &task] { task = [file](Laboratory& laboratory) { return check(laboratory, *file); }; });
}

}  // namespace kdx::ctl
