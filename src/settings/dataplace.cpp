#include "settings/dataplace.h"

#include <fstream>

#include "settings/datafolder.h"
#include "settings/profilefile.h"

namespace kdx {

namespace fs = std::filesystem;

namespace {

bool isWritableFolder(const fs::path& folder) {
    std::error_code error;
    if (!fs::is_directory(folder, error)) return false;
    const fs::path probe = folder / ".kdx-rds-writable";
    const bool written = std::ofstream(probe, std::ios::app).good();
    fs::remove(probe, error);
    return written;
}

void fillFrom(const fs::path& shipped, const DataFolder& target, std::string& problem) {
    std::error_code error;
    fs::create_directories(target.path(), error);
    if (error) {
        problem = target.path().string() + ": " + error.message();
        return;
    }
    for (auto entry = fs::directory_iterator(shipped, error); !error && entry != fs::directory_iterator();
         entry.increment(error)) {
        // A file whose name differs in letter case only is the same file.
        const fs::path file = target.file(entry->path().filename().string());
        std::error_code ignored;
        if (fs::exists(file, ignored) || !entry->is_regular_file(ignored)) continue;
        // Whole or not at all: half a file would count as the user's own from the next start on.
        const auto bytes = readFile(entry->path());
        if (!bytes || !replaceFile(file, *bytes)) {
            problem = (bytes ? file : entry->path()).string();
            return;
        }
    }
    if (error) problem = shipped.string() + ": " + error.message();
}

}  // namespace

fs::path chooseAppFolder(const DataPlaces& places, std::string& problem) {
    if (places.asked) return *places.asked;
    if (isWritableFolder(DataFolder(places.program).path())) return places.program;
    fillFrom(DataFolder(places.shipped).path(), DataFolder(places.user), problem);
    return places.user;
}

}  // namespace kdx
