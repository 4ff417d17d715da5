#include <CLI/CLI.hpp>

#include <memory>

#include "app/ctl/laboratory.h"
#include "app/ctl/whichdataset.h"
#include "base/codepage.h"
#include "base/printable.h"
#include "station/rehearsal.h"

namespace kdx::ctl {

namespace {

struct Apply {
    WhichDataSet source;
    bool keepOpen = false;
    bool dryRun = false;
};

int tellCommands(Laboratory& laboratory, const Profile& source) {
    Rehearsal rehearsal(laboratory.data(), laboratory.captions());
    rehearsal.apply(source);
    for (const std::string& command : rehearsal.commands()) {
        laboratory.output().line(toUtf8(printable(command, '.')));
        laboratory.output().document["commands"].push_back(toUtf8(command));
    }
    return kDone;
}

int apply(Laboratory& laboratory, const Apply& what) {
    const auto source = what.source.profile(laboratory);
    if (!source || !laboratory.mayBeSent(*source)) return kWrongCall;
    if (what.dryRun) return tellCommands(laboratory, *source);
    if (laboratory.hasSession()) laboratory.session().load(*source);
    if (!laboratory.open()) return kNoConnection;
    laboratory.session().sendOpening();
    if (what.keepOpen) {
        laboratory.keepOpen();
    } else {
        laboratory.close();
    }
    return laboratory.result();
}

}  // namespace

void addApply(CLI::App& app, Task& task) {
    auto what = std::make_shared<Apply>();
    CLI::App* command = app.add_subcommand("apply", "Send a whole data set, as opening the session in the window does");
    what->source.addTo(*command);
    command->add_flag("--keep-open", what->keepOpen, "do not close the link at the end");
    command->add_flag("--dry-run", what->dryRun, "print the commands and send none");
    command->footer(
        "--data-set or --file says which. At the end the link is closed; no command that makes the instrument local "
        "is\n"
        "ever sent. --keep-open leaves the closing out: an instrument on the GPIB stays in remote as it is; one on the "
        "LAN\n"
        "loses the link all the same when the program ends, and decides itself.\n"
        "Example: kdx-ctl apply --data-set 2");
    command->callback([what, &task] { task = [what](Laboratory& laboratory) { return apply(laboratory, *what); }; });
}

}  // namespace kdx::ctl
