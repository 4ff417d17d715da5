#include <CLI/CLI.hpp>

#include <memory>

#include "air/broadcast.h"
#include "air/deviationbudget.h"
#include "air/groupbudget.h"
#include "app/ctl/aircommands.h"
#include "app/ctl/laboratory.h"
#include "base/numbers.h"

namespace kdx::ctl {

namespace {

std::string percent(double share) {
    return fixedDecimal(100 * share, 1) + " %";
}

std::string seconds(double value) {
    return fixedDecimal(value, 2) + " s";
}

void tellGroups(Output& output, const air::GroupBudget& budget) {
    nlohmann::json& document = output.document["groups"];
    document = {
        {"shares", nlohmann::json::object()}, {"waits", nlohmann::json::array()}, {"warnings", budget.warnings}};
    Output::Rows shares{{"group", "share"}};
    for (const auto& [type, share] : budget.shares) {
        shares.push_back({nameOf(type), percent(share)});
        document["shares"][nameOf(type)] = share;
    }
    Output::Rows waits{{"a radio waits for", "mean", "at most"}};
    for (const auto& [what, isSet, wait] : budget.items) {
        const std::string name(nameOf(what));
        nlohmann::json row = {{"what", name}, {"set", isSet}};
        if (wait) {
            waits.push_back({name, seconds(wait->mean), seconds(wait->worst)});
            row["mean_seconds"] = wait->mean;
            row["worst_seconds"] = wait->worst;
        } else {
            waits.push_back({name, isSet ? "never" : "not set"});
        }
        document["waits"].push_back(std::move(row));
    }
    if (!budget.shares.empty()) {
        output.table(shares);
        output.line("");
    }
    output.table(waits);
}

void tellDeviations(Output& output, const air::DeviationBudget& budget) {
    Output::Rows rows{{"deviation", "kHz", "of " + fixedDecimal(budget.parts.total / 1000, 2) + " in all",
                       "of " + fixedDecimal(air::kHighestDeviation / 1000, 0)}};
    nlohmann::json& document = output.document["deviations"];
    document = {{"total_hertz", budget.parts.total}, {"parts", nlohmann::json::array()}, {"warnings", budget.warnings}};
    for (const auto& [name, hertz, ofTotal, ofHighest] : budget.rows) {
        rows.push_back({name, fixedDecimal(hertz / 1000, 2), percent(ofTotal), percent(ofHighest)});
        document["parts"].push_back(
            {{"name", name}, {"hertz", hertz}, {"of_total", ofTotal}, {"of_highest", ofHighest}});
    }
    output.table(rows);
}

int judge(Laboratory& laboratory, const AirCommands& what) {
    if (!what.source.isNamed() && what.log.empty() && what.commandFile.empty()) {
        (void)what.source.profile(laboratory);  // which tells that none is named
        return kWrongCall;
    }
    const auto commands = commandsOf(laboratory, what);
    if (!commands) return kWrongCall;
    Output& output = laboratory.output();
    const air::AirTime start = air::airTimeOf(SystemClock());
    air::Broadcast broadcast(start, [&output](const std::string& text) { output.warning(text); });
    for (const air::TimedCommand& command : *commands) broadcast.execute(command.command, start + command.after);

    const air::GroupBudget groups = air::groupBudgetOf(broadcast.transmission());
    const air::DeviationBudget deviations = air::deviationBudgetOf(broadcast.transmission().settings);
    tellGroups(output, groups);
    output.line("");
    tellDeviations(output, deviations);
    for (const auto& warnings : {groups.warnings, deviations.warnings}) {
        for (const std::string& warning : warnings) output.warning(warning);
    }
    // A command that was refused is told too, but not the budgets' fault.
    const bool hasWarning = !groups.warnings.empty() || !deviations.warnings.empty();
    return hasWarning ? kDifferent : laboratory.result();
}

}  // namespace

void addBudget(CLI::App& app, Task& task) {
    auto what = std::make_shared<AirCommands>();
    CLI::App* command =
        app.add_subcommand("budget", "Tell what groups and deviation are spent on, and how long a radio waits");
    what->addTo(*command);
    command->footer(
        "--data-set or --file says which, unless --log or --commands is given; of commands with times all are done.\n"
        "The waits are those of a radio that tunes in at any moment. A warning of a budget makes the exit code 3.\n"
        "Example: kdx-ctl budget --data-set 2");
    command->callback([what, &task] { task = [what](Laboratory& laboratory) { return judge(laboratory, *what); }; });
}

}  // namespace kdx::ctl
