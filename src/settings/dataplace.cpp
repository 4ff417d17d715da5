#include "settings/dataplace.h"

#include <algorithm>
#include <array>
#include <fstream>

#include "settings/datafolder.h"
#include "settings/leftovers.h"

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

}  // namespace

fs::path chooseAppFolder(const DataPlaces& places, DataNews& news) {
    if (places.asked) return *places.asked;
    if (isWritableFolder(DataFolder(places.program).path())) return places.program;
    if (!places.user.is_absolute()) {
        // Never a folder in the current one, wherever that happens to be: nothing is kept then.
        news.problem =
            "no folder is known for your settings, so that they cannot be kept: HOME is not set (on Windows: APPDATA). "
            "Set it, or name a folder with --app-folder.";
        return places.program;
    }
    bringUpToDate(DataFolder(places.user), DataFolder(places.shipped).path(), shippedVersions(), places.heard, news);
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
