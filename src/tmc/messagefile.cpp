#include "tmc/messagefile.h"

#include "base/split.h"
#include "settings/folderlock.h"
#include "settings/profilefile.h"
#include "settings/withoutcontrols.h"
#include "tmc/groupcode.h"
#include "tmc/messagelist.h"

#include <utility>

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

struct Lines {
    std::vector<std::string> entries, others;
};

Lines sorted(std::string_view content) {
    Lines lines;
    for (std::string_view line : split(content, "\n")) {
        if (line.ends_with('\r')) line.remove_suffix(1);
        std::string entry = withoutControls(line);
        if (isEntry(entry) && lines.entries.size() < kMostEntries) {
            lines.entries.push_back(std::move(entry));
        } else if (!line.empty()) {
            lines.others.emplace_back(line);
        }
    }
    return lines;
}

bool replaceEntries(const std::filesystem::path& file, const std::vector<std::string>& entries) {
    const auto content = readFile(file);
    std::error_code error;
    if (!content && std::filesystem::symlink_status(file, error).type() != std::filesystem::file_type::not_found)
        return false;
    std::string bytes;
    for (const std::string& line : sorted(content.value_or(std::string())).others) bytes += line + "\r\n";
    for (const std::string& entry : entries) bytes += entry + "\r\n";
    return replaceFile(file, bytes);
}

}  // namespace

std::vector<std::string> loadMessages(const std::filesystem::path& file) {
    return sorted(readFile(file).value_or(std::string())).entries;
}

bool storeMessages(const std::filesystem::path& file, const std::vector<std::string>& entries) {
    bool stored = false;
    return underFolderLock(file.parent_path(), [&] { stored = replaceEntries(file, entries); }) && stored;
}

}  // namespace kdx
