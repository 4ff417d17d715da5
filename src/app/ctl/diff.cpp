#include <CLI/CLI.hpp>

#include <memory>

#include "app/ctl/laboratory.h"
#include "app/ctl/readings.h"
#include "app/ctl/whichdataset.h"
#include "station/comparison.h"

namespace kdx::ctl {

namespace {

struct Diff {
    WhichDataSet source;
    bool fix = false;
};

/// Asks the instrument for everything; nothing when that failed.
std::optional<Readout> askedFor(Laboratory& laboratory) {
    Readout readout = readOut(laboratory.session().instrument);
    return laboratory.result() == kDone ? std::optional(std::move(readout)) : std::nullopt;
}

int diff(Laboratory& laboratory, const Diff& what) {
    const auto source = what.source.profile(laboratory);
    if (!source) return kWrongCall;
    if (!laboratory.open()) return kNoConnection;
    auto present = askedFor(laboratory);
    if (!present) return laboratory.result();
    const Comparison comparison = compared(laboratory.data(), laboratory.captions(), *source, *present);
    tellUnanswered(laboratory.output(), *present);
    tellDifferences(laboratory.output(), "differences", comparison.differing);
    Differences left = comparison.differing;
    if (what.fix && !left.empty()) {
        const SettingCommands commands =
            commandsFor(comparison.differing, comparison.wanted, laboratory.state().corrections);
        laboratory.expect(commands.size());
        for (const auto& [key, command] : commands) {
            if (laboratory.goesOn()) laboratory.session().params.sendCommand(key, command);
        }
        laboratory.expect(0);
        if (laboratory.result() == kDone) present = askedFor(laboratory);
        if (!present || laboratory.result() != kDone) return laboratory.result();
        left = compared(laboratory.data(), laboratory.captions(), *source, *present).differing;
        laboratory.output().remark(left.empty() ? "all of it is mended" : "what differs still:");
        tellDifferences(laboratory.output(), "left", left);
    }
    laboratory.close();
    if (laboratory.result() != kDone) return laboratory.result();
    return left.empty() && unanswered(*present).empty() ? kDone : kDifferent;
}

}  // namespace

void addDiff(CLI::App& app, Task& task) {
    auto what = std::make_shared<Diff>();
    CLI::App* command =
        app.add_subcommand("diff", "Compare what the instrument has with what a data set would make of it");
    what->source.addTo(*command);
    command->add_flag("--fix", what->fix, "send what differs, and nothing else");
    command->footer("--data-set or --file says which.\nExample: kdx-ctl diff --data-set 2");
    command->callback([what, &task] { task = [what](Laboratory& laboratory) { return diff(laboratory, *what); }; });
}

}  // namespace kdx::ctl
