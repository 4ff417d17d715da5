#include "tmc/tmclist.h"

#include "base/numbers.h"
#include "settings/profilefile.h"

namespace kdx {

namespace {

constexpr std::string_view kLineEnd = "\r\n";

}  // namespace

std::optional<std::string> shownEntry(std::string_view line) {
    const std::size_t semicolon = line.find(';');
    if (semicolon == std::string_view::npos) return std::nullopt;
    std::string entry = padRight(line.substr(0, semicolon), kListTextLength);
    entry += line.substr(semicolon + 1);
    return entry;
}

std::optional<std::vector<std::string>> loadTmcList(const std::filesystem::path& file) {
    const std::optional<std::string> content = readFile(file);
    if (!content) return std::nullopt;
    std::vector<std::string> entries;
    for (std::string_view rest = *content; !rest.empty();) {
        const std::size_t lineFeed = rest.find('\n');
        std::string_view line = rest.substr(0, lineFeed);
        rest.remove_prefix(lineFeed == std::string_view::npos ? rest.size() : lineFeed + 1);
        if (line.ends_with('\r')) line.remove_suffix(1);
        if (auto entry = shownEntry(line)) entries.push_back(std::move(*entry));
    }
    return entries;
}

bool appendToTmcList(const std::filesystem::path& file, std::string_view text, std::string_view code) {
    const std::optional<std::string> content = readToChange(file);
    if (!content) return false;
    std::string bytes = *content;
    if (!bytes.empty() && bytes.back() != '\n') bytes += kLineEnd;
    bytes += text;
    bytes += ';';
    bytes += code;
    bytes += kLineEnd;
    return replaceFile(file, bytes);
}

}  // namespace kdx
