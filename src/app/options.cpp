#include "app/options.h"

namespace kdx {

Options parseOptions(const std::vector<std::string>& arguments) {
    Options options;
    for (std::size_t i = 0; i < arguments.size(); ++i) {
        std::string name = arguments[i];
        std::optional<std::string> attached;
        if (const auto equals = name.find('='); name.starts_with("--") && equals != std::string::npos) {
            attached = name.substr(equals + 1);
            name.erase(equals);
        }
        const auto take = [&](std::optional<std::string>& into) {
            if (attached) {
                into = *attached;
            } else if (i + 1 < arguments.size()) {
                into = arguments[++i];
            }
            if (!into || into->empty()) options.error = name + " needs a value";
        };
        const auto flag = [&](bool& into) {
            into = true;
            if (attached) options.error = name + " takes no value";
        };
        if (name == "--app-folder") {
            take(options.appFolder);
        } else if (name == "--visa-library") {
            take(options.visaLibrary);
        } else if (name == "--tour") {
            take(options.tourFolder);
        } else if (name == "--simulate") {
            flag(options.simulate);
        } else if (name == "--help") {
            flag(options.help);
        } else if (name == "--version") {
            flag(options.version);
        } else {
            options.error = "unknown option " + arguments[i];
        }
        if (!options.error.empty()) return options;
    }
    if (options.simulate && options.visaLibrary) options.error = "--simulate and --visa-library exclude each other";
    return options;
}

std::string helpText() {
    return "Usage: kdx-rds [options]\n"
           "Sets up what a KDX signal generator with stereo/RDS coder transmits.\n"
           "\n"
           "  --app-folder DIR     the program's folder; settings and texts are in DIR/Daten\n"
           "  --visa-library FILE  use this VISA library to reach the instrument\n"
           "  --simulate           use the virtual instrument inside the program\n"
           "  --tour DIR           open the session, show every page, leave a picture of each in DIR,\n"
           "                       ask every value back, print the traffic and end\n"
           "  --version            print the version and how instruments are reached\n"
           "  --help               print this text\n";
}

}  // namespace kdx
