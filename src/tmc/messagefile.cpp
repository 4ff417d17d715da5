#include "tmc/messagefile.h"

#include "base/split.h"
#include "settings/folderlock.h"
#include "settings/profilefile.h"
#include "settings/withoutcontrols.h"
#include "tmc/groupcode.h"
#include "tmc/messagelist.h"

namespace kdx {

namespace {

constexpr std::size_t kMostEntries = 10000;

/// The code of another line would be no message.
bool isEntry(const std::string& line) {
    constexpr std::size_t kEvent = kMessageTextLength + kAfterLocation.size();
    constexpr std::size_t kCode = kEvent + kMessageTextLength + kAfterEvent.size();
    return line.size() == kCode + kGroupCodeLength &&
           line.compare(kMessageTextLength, kAfterLocation.size(), kAfterLocation) == 0 &&
           line.compare(kEvent + kMessageTextLength, kAfterEvent.size(), kAfterEvent) == 0;
}

}  // namespace

std::vector<std::string> loadMessages(const std::filesystem::path& file) {
    std::vector<std::string> entries;
    const auto content = readFile(file);
    if (!content) return entries;
    for (std::string_view line : split(*content, "\n")) {
        if (line.ends_with('\r')) line.remove_suffix(1);
        const std::string entry = withoutControls(line);
        if (isEntry(entry) && entries.size() < kMostEntries) entries.push_back(entry);
    }
    return entries;
}

bool storeMessages(const std::filesystem::path& file, const std::vector<std::string>& entries) {
    std::string bytes;
    for (const std::string& entry : entries) bytes += entry + "\r\n";
    bool stored = false;
    return underFolderLock(file.parent_path(), [&] { stored = replaceFile(file, bytes); }) && stored;
}

}  // namespace kdx
