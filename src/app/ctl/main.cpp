// The command line of kdx-ctl.
#include <CLI/CLI.hpp>

#include <algorithm>
#include <cstdio>
#include <exception>
#include <string_view>

#include "app/ctl/call.h"
#include "app/ctl/laboratory.h"
#include "app/ctl/output.h"
#include "app/ctl/secondsoption.h"
#include "app/platform.h"
#include "link/resource.h"
#include "settings/shownpath.h"

namespace {

using kdx::ctl::Call;

void addConnection(CLI::App& app, Call& call) {
    auto* lan = app.add_option("--lan", call.lan, "the instrument's address, and its device name behind a comma")
                    ->type_name("HOST[,DEVICE]");
    auto* gpib = app.add_option("--gpib", call.gpib, "the instrument's GPIB address")
                     ->check(CLI::Range(0, kdx::kHighestGpibAddress))
                     ->excludes(lan);
    auto* library =
        app.add_option("--visa-library", call.program.visaLibrary, "use this VISA library")->type_name("FILE");
    app.add_flag("--simulate", call.program.simulate, "use the virtual instrument inside the program")
        ->excludes(lan)
        ->excludes(gpib)
        ->excludes(library);
    app.add_option("--app-folder", call.program.appFolder, "the program's folder; settings and texts are in DIR/Daten")
        ->type_name("DIR");
}

/// How long an answer may take. Nobody waits ten minutes for one, and a tenth of a second is what a network may need.
void addTimeout(CLI::App& app, Call& call) {
    using namespace std::chrono_literals;
    kdx::ctl::addSeconds(
        app,
        {"--timeout", 100ms, 600s, "0.1 to 600",
         "how long an answer may take, 0.1 to 600; else 2 over the LAN, the VISA library's own time with one"},
        [&call](std::chrono::milliseconds time) { call.program.answerTime = time; });
}

void addManner(CLI::App& app, Call& call) {
    app.add_flag("--json", call.json, "one JSON document instead of words");
    auto* quiet = app.add_flag("-q,--quiet", call.quiet, "only results and problems");
    app.add_flag("-v,--verbose", call.verbose, "every command and answer with its time and status")->excludes(quiet);
    app.add_flag("--force", call.force, "send also values that are not legal");
    app.add_flag("--continue", call.continues, "go on after a command that failed");
}

int run(const Call& call, const kdx::ctl::Task& task, const char* program) {
    kdx::ctl::Output output(call);
    int result = kdx::ctl::kFailed;
    try {
        kdx::ctl::Laboratory laboratory(call, output, program, kdx::endRequests());
        result = task(laboratory);
    } catch (const std::exception& error) {
        output.problem(error.what());
    }
    return output.finish(result);
}

/// What is wrong with the call. The parser misses a subcommand before it looks at a word that is none.
std::string sentence(const CLI::App& app, const CLI::Error& error) {
    const auto words = app.remaining();
    const auto word = std::find_if(words.begin(), words.end(), [](const auto& text) { return !text.starts_with('-'); });
    const bool unknown = app.get_parent() == nullptr && app.get_subcommands().empty() && word != words.end();
    return kdx::shownText(unknown ? "there is no subcommand " + *word : std::string(error.what()));
}

/// What the parser has to say: help that was asked for, or what is wrong with the call.
int answered(const CLI::App& app, const CLI::ParseError& said, Call call) {
    kdx::ctl::Output output(call);
    if (app.exit(said) == 0) {
        call.json = false;  // help is words
        return output.finish(kdx::ctl::kDone);
    }
    output.note(sentence(app, said));
    return output.finish(kdx::ctl::kWrongCall);
}

int called(int argc, const char* const* argv) {
    CLI::App app("Sets up what a KDX signal generator with stereo/RDS coder transmits, without a window.", "kdx-ctl");
    app.set_version_flag("--version", "KDX-RDS " KDX_VERSION);
    app.fallthrough();  // the options of the connection stand anywhere
    app.require_subcommand(1);
    Call call;
    addConnection(app, call);
    addTimeout(app, call);
    addManner(app, call);
    kdx::ctl::Task task;
    for (const auto add :
         {kdx::ctl::addAir, kdx::ctl::addApply, kdx::ctl::addBudget, kdx::ctl::addCheck, kdx::ctl::addDiff,
          kdx::ctl::addFind, kdx::ctl::addList, kdx::ctl::addPlay, kdx::ctl::addQuery, kdx::ctl::addRead,
          kdx::ctl::addReplay, kdx::ctl::addSend, kdx::ctl::addShell}) {
        add(app, task);
    }
    app.footer(
        "Try these; with --simulate no instrument is needed:\n"
        "  kdx-ctl --simulate apply --data-set 2\n"
        "  kdx-ctl --simulate query ps pi rt\n"
        "  kdx-ctl --simulate send PS=MESSTURM TP=1 HF-Frequenz=98.5\n"
        "  kdx-ctl apply --data-set 3 --dry-run\n"
        "  kdx-ctl list keys\n"
        "Without --lan, --gpib or --simulate the instrument is the one of the general settings.\n"
        "Exit codes: 0 done, 1 a command failed, 2 wrong call or unreadable file, 3 differences or warnings,\n"
        "4 no connection.\n"
        "kdx-ctl SUBCOMMAND --help says more.");
    app.failure_message([](const CLI::App* failed, const CLI::Error& error) {
        return sentence(*failed, error) + "\nRun with --help for more information.\n";
    });
    try {
        app.parse(argc, argv);
    } catch (const CLI::ParseError& said) {
        // The parser may have given up before it came to that.
        call.json = std::find(argv, argv + argc, std::string_view("--json")) != argv + argc;
        return answered(app, said, call);
    }
    return run(call, task, argv[0]);
}

}  // namespace

int main(int argc, char** argv) {
    kdx::openStandardStreams();
    kdx::useTerminal();
    // Who does not want to read on stops nothing that is half sent.
    kdx::surviveBrokenPipes();
    try {
        return called(argc, argv);
    } catch (const std::exception& error) {
        std::fprintf(stderr, "kdx-ctl: %s\n", error.what());
        return kdx::ctl::kFailed;
    }
}
