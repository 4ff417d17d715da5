#include "app/options.h"

#include <CLI/CLI.hpp>

#include <algorithm>
#include <memory>
#include <utility>

namespace kdx {

namespace {

/// The command line's options, which fill `options` when they are read.
std::unique_ptr<CLI::App> commandLine(Options& options) {
    auto app =
        std::make_unique<CLI::App>("Sets up what a KDX signal generator with stereo/RDS coder transmits.", "kdx-rds");
    app->set_help_flag();  // a flag like the others: without a short form, and it takes no value
    app->add_option("--app-folder", options.appFolder, "the program's folder; settings and texts are in DIR/Daten")
        ->type_name("DIR")
        ->take_last();
    auto* library =
        app->add_option("--visa-library", options.visaLibrary, "use this VISA library to reach the instrument")
            ->type_name("FILE")
            ->take_last();
    auto* simulate = app->add_flag("--simulate", options.simulate, "use the virtual instrument inside the program")
                         ->disable_flag_override()
                         ->excludes(library);
    auto* tour =
        app->add_option(
               "--tour", options.tourFolder,
               "open the session, show every page, leave a picture of each in DIR, ask every value back, print "
               "the traffic and end; needs no display")
            ->type_name("DIR")
            ->take_last();
    app->add_flag("--views", options.views,
                  "let the tour go on through menus, views and editors, at a time of its own; needs --simulate")
        ->disable_flag_override()
        ->needs(tour)
        ->needs(simulate);
    app->add_flag("--version", options.version, "print the version and how instruments are reached")
        ->disable_flag_override();
    app->add_flag("--help", options.help, "print this text")->disable_flag_override();
    return app;
}

}  // namespace

Options parseOptions(const std::vector<std::string>& arguments) {
    Options options;
    std::vector<std::string> reversed(arguments.rbegin(), arguments.rend());  // as the library takes them
    try {
        commandLine(options)->parse(reversed);
    } catch (const CLI::ParseError& error) {
        options.error = error.what();
    }
    for (const auto& [name, value] :
         {std::pair{"--app-folder", &options.appFolder}, std::pair{"--visa-library", &options.visaLibrary},
          std::pair{"--tour", &options.tourFolder}}) {
        if (options.error.empty() && *value && (*value)->empty()) options.error = std::string(name) + " needs a value";
    }
    return options;
}

std::string helpText() {
    Options options;
    return commandLine(options)->help();
}

}  // namespace kdx
