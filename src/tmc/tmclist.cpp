#include "tmc/tmclist.h"

#include <algorithm>
#include <functional>
#include <utility>

#include "base/numbers.h"
#include "settings/folderlock.h"
#include "settings/profilefile.h"

namespace kdx {

namespace {

constexpr std::string_view kLineEnd = "\r\n";
constexpr std::size_t kLongestShown = 1000;

}  // namespace

std::optional<std::string> shownEntry(std::string_view line) {
    const std::size_t semicolon = line.find(';');
    if (semicolon == std::string_view::npos) return std::nullopt;
    std::string entry = padRight(line.substr(0, std::min(semicolon, kListTextLength)), kListTextLength);
    entry += line.substr(semicolon + 1, kLongestShown - kListTextLength);
    return entry;
}

TmcList::TmcList(std::string bytes) : m_bytes(std::move(bytes)) {
    for (std::size_t begin = 0; begin < m_bytes.size();) {
        const std::size_t end = std::min(m_bytes.find('\n', begin), m_bytes.size());
        std::string_view line(m_bytes.data() + begin, end - begin);
        if (line.ends_with('\r')) line.remove_suffix(1);
        if (line.find(';') != std::string_view::npos) m_lines.push_back({begin, line.size()});
        begin = end + 1;
    }
}

std::string TmcList::operator[](std::size_t index) const {
    return shownEntry(line(index)).value();
}

std::string_view TmcList::line(std::size_t index) const {
    const Line& line = m_lines.at(index);
    return std::string_view(m_bytes).substr(line.begin, line.length);
}

std::optional<TmcList> loadTmcList(const std::filesystem::path& file) {
    std::optional<std::string> content = readFile(file);
    return content ? std::optional<TmcList>(std::in_place, std::move(*content)) : std::nullopt;
}

namespace {

bool appendLine(const std::filesystem::path& file, std::string_view text, std::string_view code) {
    const std::optional<std::string> content = readToChange(file);
    if (!content) return false;
    std::string bytes = *content;
    // A carriage return at the end is half a line end: a whole one would add the return to the last entry's code.
    if (bytes.ends_with('\r')) {
        bytes += '\n';
    } else if (!bytes.empty() && bytes.back() != '\n') {
        bytes += kLineEnd;
    }
    bytes += text;
    bytes += ';';
    bytes += code;
    bytes += kLineEnd;
    return replaceFile(file, bytes);
}

}  // namespace

bool appendToTmcList(const std::filesystem::path& file, std::string_view text, std::string_view code) {
    bool appended = false;
    return underFolderLock(file.parent_path(), [&] { appended = appendLine(file, text, code); }) && appended;
}

namespace {

/// Changes the line of that number among those with a semicolon, its line end included.
bool changeLine(const std::filesystem::path& file, std::size_t index, std::string_view expected,
                const std::function<std::string(std::string_view lineEnd)>& changed) {
    std::optional<std::string> content = readToChange(file);
    if (!content) return false;
    const std::string_view bytes = *content;
    std::size_t number = 0;
    for (std::size_t begin = 0; begin < bytes.size();) {
        const std::size_t newline = bytes.find('\n', begin);
        const std::size_t next = newline == std::string_view::npos ? bytes.size() : newline + 1;
        std::string_view line = bytes.substr(begin, next - begin);
        if (line.ends_with('\n')) line.remove_suffix(1);
        if (line.ends_with('\r')) line.remove_suffix(1);
        if (line.find(';') != std::string_view::npos && number++ == index) {
            if (line != expected) return false;
            const std::string lineEnd(bytes.substr(begin + line.size(), next - begin - line.size()));
            return replaceFile(file, content->replace(begin, next - begin, changed(lineEnd)));
        }
        begin = next;
    }
    return false;
}

}  // namespace

bool changeInTmcList(const std::filesystem::path& file, std::size_t index, std::string_view line, std::string_view text,
                     std::string_view code) {
    bool changed = false;
    const auto change = [&] {
        changed = changeLine(file, index, line, [&](std::string_view lineEnd) {
            return std::string(text).append(";").append(code).append(lineEnd);
        });
    };
    return underFolderLock(file.parent_path(), change) && changed;
}

bool removeFromTmcList(const std::filesystem::path& file, std::size_t index, std::string_view line) {
    bool removed = false;
    const auto remove = [&] {
        removed = changeLine(file, index, line, [](std::string_view) { return std::string(); });
    };
    return underFolderLock(file.parent_path(), remove) && removed;
}

}  // namespace kdx
