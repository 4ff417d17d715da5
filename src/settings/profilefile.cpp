#include "settings/profilefile.h"

#include <algorithm>
#include <fstream>
#include <sstream>
#include <system_error>
#include <utility>

#include "base/codepage.h"

namespace kdx {

namespace {

constexpr std::string_view kLineEnd = "\r\n";

/// One line in the bytes: its text is [begin, end), the next line starts at `next`.
struct Line {
    std::size_t begin = 0;
    std::size_t end = 0;
    std::size_t next = 0;
};

/// Where a key is, or where it would have to go.
struct Place {
    bool sectionFound = false;
    std::optional<Line> keyLine;
    std::size_t newKeyAt = 0;  ///< behind the section's last key, or behind its header when it has none
};

bool isBlank(char c) {
    return c == ' ' || c == '\t' || c == '\v';
}

bool isLineEnd(char c) {
    return c == '\r' || c == '\n';
}

std::string_view trimmed(std::string_view text) {
    while (!text.empty() && isBlank(text.front())) text.remove_prefix(1);
    while (!text.empty() && isBlank(text.back())) text.remove_suffix(1);
    return text;
}

Line lineAt(std::string_view bytes, std::size_t begin) {
    std::size_t end = begin;
    while (end < bytes.size() && !isLineEnd(bytes[end])) ++end;
    const bool twoBytes = bytes.substr(end).starts_with(kLineEnd);
    return {begin, end, twoBytes ? end + 2 : std::min(end + 1, bytes.size())};
}

std::string_view textOf(std::string_view bytes, const Line& line) {
    return trimmed(bytes.substr(line.begin, line.end - line.begin));
}

/// The part before the first '='; a line without one is a key without a value.
std::string_view keyOf(std::string_view lineText) {
    return trimmed(lineText.substr(0, lineText.find('=')));
}

std::string_view sectionOf(std::string_view header) {
    return trimmed(header.substr(1, header.find(']') - 1));
}

std::string_view withoutQuotes(std::string_view value) {
    const bool quoted =
        value.size() >= 2 && value.front() == value.back() && (value.front() == '"' || value.front() == '\'');
    return quoted ? value.substr(1, value.size() - 2) : value;
}

std::string valueOf(std::string_view lineText, std::size_t longest) {
    const std::size_t equals = lineText.find('=');
    if (equals == std::string_view::npos) return {};
    return std::string(withoutQuotes(trimmed(lineText.substr(equals + 1))).substr(0, longest));
}

Place find(std::string_view bytes, std::string_view section, std::string_view key) {
    Place place;
    Line line;
    for (std::size_t at = 0; at < bytes.size(); at = line.next) {
        line = lineAt(bytes, at);
        const std::string_view text = textOf(bytes, line);
        if (text.empty() || text.front() == ';') continue;
        if (text.front() == '[') {
            if (place.sectionFound) break;  // a later section of the same name is never searched
            place.sectionFound = equalNoCase(sectionOf(text), section);
            place.newKeyAt = line.next;
        } else if (place.sectionFound) {
            place.newKeyAt = line.next;
            if (!equalNoCase(keyOf(text), key)) continue;
            place.keyLine = line;
            break;
        }
    }
    return place;
}

std::string assignment(std::string_view key, std::string_view value) {
    return std::string(key).append("=").append(value);
}

}  // namespace

ProfileText::ProfileText(std::string bytes) : m_bytes(std::move(bytes)) {}

std::string ProfileText::value(std::string_view section, std::string_view key, std::size_t longest) const {
    const Place place = find(m_bytes, trimmed(section), trimmed(key));
    if (!place.keyLine) return {};
    return valueOf(textOf(m_bytes, *place.keyLine), longest);
}

std::map<std::string, std::string> ProfileText::section(std::string_view name) const {
    std::map<std::string, std::string> values;
    bool found = false;
    Line line;
    for (std::size_t at = 0; at < m_bytes.size(); at = line.next) {
        line = lineAt(m_bytes, at);
        const std::string_view text = textOf(m_bytes, line);
        if (text.empty() || text.front() == ';') continue;
        if (text.front() == '[') {
            if (found) break;
            found = equalNoCase(sectionOf(text), trimmed(name));
        } else if (found) {
            values.emplace(keyOf(text), valueOf(text, kLongestValue));
        }
    }
    return values;
}

void ProfileText::setValue(std::string_view section, std::string_view key, std::string_view value) {
    section = trimmed(section);
    key = trimmed(key);
    const Place place = find(m_bytes, section, key);
    if (place.keyLine) {
        const Line& line = *place.keyLine;
        std::string replaced = assignment(keyOf(textOf(m_bytes, line)), value);  // the key keeps its spelling
        if (line.next == line.end) replaced += kLineEnd;                         // the file's last line had none
        m_bytes.replace(line.begin, line.end - line.begin, replaced);
        return;
    }
    std::string added = assignment(key, value).append(kLineEnd);
    if (!place.sectionFound) added.insert(0, std::string("[").append(section).append("]").append(kLineEnd));
    const std::size_t at = place.sectionFound ? place.newKeyAt : m_bytes.size();
    if (at > 0 && !isLineEnd(m_bytes[at - 1])) added.insert(0, kLineEnd);
    m_bytes.insert(at, added);
}

std::optional<std::string> readFile(const std::filesystem::path& file) {
    // Only real files: a folder cannot be read, and a pipe or device in the file's place could block for ever.
    std::error_code error;
    if (!std::filesystem::is_regular_file(file, error)) return std::nullopt;
    std::ifstream stream(file, std::ios::binary);
    if (!stream) return std::nullopt;
    std::ostringstream bytes;
    if (stream.peek() != std::ifstream::traits_type::eof()) bytes << stream.rdbuf();
    if (stream.bad() || !bytes) return std::nullopt;
    return std::move(bytes).str();
}

std::optional<std::string> readToChange(const std::filesystem::path& file) {
    std::optional<std::string> bytes = readFile(file);
    std::error_code error;
    const auto type = std::filesystem::status(file, error).type();
    // A link that leads nowhere counts as missing: what is written goes where it leads.
    if (!bytes && type == std::filesystem::file_type::not_found) bytes.emplace();
    return bytes;
}

}  // namespace kdx
