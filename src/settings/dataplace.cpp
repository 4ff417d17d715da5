#include "settings/dataplace.h"

#include <algorithm>
#include <array>
#include <fstream>

#include "settings/datafolder.h"
#include "settings/leftovers.h"
#include "settings/profilefile.h"
#include "settings/shownpath.h"

namespace kdx {

namespace fs = std::filesystem;

namespace {

bool isWritableFolder(const fs::path& folder) {
    std::error_code error;
    if (!fs::is_directory(folder, error)) return false;
    const fs::path probe = writableProbe(folder);
    const bool written = std::ofstream(probe, std::ios::app).good();
    fs::remove(probe, error);
    return written;
}

void fillFrom(const fs::path& shipped, const DataFolder& target, std::string& problem) {
    std::error_code error;
    fs::create_directories(target.path(), error);
    if (error) {
        problem = shownPath(target.path()) + ": " + error.message();
        return;
    }
    for (auto entry = fs::directory_iterator(shipped, error); !error && entry != fs::directory_iterator();
         entry.increment(error)) {
        // A file whose name differs in letter case only is the same file.
        const fs::path file = target.file(entry->path().filename());
        std::error_code ignored;
        if (fs::exists(file, ignored) || !entry->is_regular_file(ignored)) continue;
        // Whole or not at all: half a file would count as the user's own from the next start on.
        const auto bytes = readFile(entry->path());
        if (!bytes || !replaceFile(file, *bytes)) {
            problem = shownPath(bytes ? file : entry->path());
            return;
        }
    }
    if (error) problem = shownPath(shipped) + ": " + error.message();
}

}  // namespace

fs::path chooseAppFolder(const DataPlaces& places, std::string& problem) {
    if (places.asked) return *places.asked;
    if (isWritableFolder(DataFolder(places.program).path())) return places.program;
    if (!places.user.is_absolute()) {
        // Never a folder in the current one, wherever that happens to be: nothing is kept then.
        problem =
            "no folder is known for your settings, so that they cannot be kept: HOME is not set (on Windows: APPDATA). "
            "Set "
            "it, or name a folder with --app-folder.";
        return places.program;
    }
    fillFrom(DataFolder(places.shipped).path(), DataFolder(places.user), problem);
    return places.user;
}

fs::path shippedFolder(const fs::path& program) {
    const fs::path share = program.parent_path() / "share";
    const std::array places = {share / "kdx-rds", share / "kdx-tools", program};
    const auto found = std::find_if(places.begin(), places.end(), [](const fs::path& place) {
        std::error_code error;  // a folder that nobody may look into counts as none
        return fs::is_directory(DataFolder(place).path(), error);
    });
    return found == places.end() ? places.front() : *found;
}

}  // namespace kdx
