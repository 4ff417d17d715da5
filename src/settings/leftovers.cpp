#include "settings/leftovers.h"

#include <algorithm>
#include <array>
#include <charconv>
#include <chrono>
#include <cstdint>
#include <optional>
#include <string>
#include <string_view>
#include <system_error>
#include <vector>

#include "base/codepage.h"
#include "base/numbers.h"
#include "settings/datafolder.h"
#include "settings/durablefile.h"
#include "settings/folderlock.h"
#include "settings/shownpath.h"

namespace kdx {

namespace {

namespace fs = std::filesystem;

constexpr std::string_view kSuffix = ".kdx-rds-new";
constexpr const char* kProbe = ".kdx-rds-writable";
constexpr std::string_view kEarlierSuffix = ".new";  // of versions that named them NAME.COUNT.new
constexpr std::array kFiles = {kGeneralSettings, kLanguageFile, kEventList, kLocationList};

/// Takes the part behind the last point off the name.
std::string_view takeExtension(std::string_view& name) {
    const std::size_t point = name.rfind('.');
    if (point == std::string_view::npos) return {};
    const std::string_view extension = name.substr(point + 1);
    name = name.substr(0, point);
    return extension;
}

/// The process that gave a momentary file its name; nothing for every other file.
std::optional<std::uint64_t> writerOf(std::string_view name) {
    if (!name.ends_with(kSuffix)) return std::nullopt;
    name.remove_suffix(kSuffix.size());
    const std::string_view count = takeExtension(name);
    const std::string_view process = takeExtension(name);
    if (name.empty() || !isDecimal(count) || !isDecimal(process)) return std::nullopt;
    std::uint64_t number = 0;
    const auto read = std::from_chars(process.data(), process.data() + process.size(), number);
    return read.ec == std::errc() ? std::optional(number) : std::nullopt;
}

bool isEarlierLeftOver(std::string_view name) {
    if (!name.ends_with(kEarlierSuffix)) return false;
    name.remove_suffix(kEarlierSuffix.size());
    if (!isDecimal(takeExtension(name))) return false;
    const auto isName = [name](std::string_view file) { return equalNoCase(name, file); };
    if (std::any_of(kFiles.begin(), kFiles.end(), isName)) return true;
    for (const char* number : {"1", "2", "3", "4", "5"}) {
        if (isName(dataSetFile(number))) return true;
    }
    return false;
}

bool isLeftOver(const fs::path& file) {
    const std::string name = shownPath(file.filename());
    if (name == kProbe) return true;  // needed for no longer than it takes to create it
    if (isEarlierLeftOver(name)) return true;
    const auto writer = writerOf(name);
    return writer && !mayStillBeWritten(file, *writer);
}

}  // namespace

fs::path nameBeside(const fs::path& file) {
    const auto count = std::chrono::steady_clock::now().time_since_epoch().count();
    fs::path beside = file;
    beside += "." + std::to_string(processNumber()) + "." + std::to_string(count) + std::string(kSuffix);
    return beside;
}

fs::path writableProbe(const fs::path& folder) {
    return folder / kProbe;
}

void sweepLeftovers(const fs::path& folder) {
    const auto sweep = [&] {
        std::vector<fs::path> found;
        std::error_code error;
        for (fs::directory_iterator entry(folder, error), end; !error && entry != end; entry.increment(error)) {
            std::error_code ignored;
            const bool isFile = fs::is_regular_file(entry->symlink_status(ignored));
            if (isFile && isLeftOver(entry->path())) found.push_back(entry->path());
        }
        for (const fs::path& file : found) fs::remove(file, error);
    };
    // While nobody writes settings; who holds the folder for long has to be left alone.
    (void)underFolderLock(folder, sweep);
}

}  // namespace kdx
