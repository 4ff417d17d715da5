#include "settings/profilefile.h"

#include <array>
#include <fstream>
#include <system_error>
#include <utility>

#include "settings/profileindex.h"
#include "settings/profilelines.h"

namespace kdx {

namespace {

constexpr std::string_view kLineEnd = "\r\n";

bool isLineEnd(char c) {
    return c == '\r' || c == '\n';
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

std::string assignment(std::string_view key, std::string_view value) {
    return std::string(key).append("=").append(value);
}

/// Behind the section's last key, or behind its header when it has none.
std::size_t endOfKeys(std::string_view bytes, const ProfileLine& header) {
    std::size_t end = header.next;
    ProfileLine line;
    for (ProfileLines lines(bytes, header.next); lines.next(line);) {
        const std::string_view text = textOf(bytes, line);
        if (isHeader(text)) break;
        if (!saysNothing(text)) end = line.next;
    }
    return end;
}

/// Hands over the file's bytes piece by piece until they are not wanted. False when that was not to the end.
bool readPieces(const std::filesystem::path& file, const std::function<bool(std::string_view piece)>& take) {
    // Only real files: a folder cannot be read, and a pipe or device in the file's place could block for ever.
    std::error_code error;
    if (!std::filesystem::is_regular_file(file, error)) return false;
    std::ifstream stream(file, std::ios::binary);
    if (!stream) return false;
    std::array<char, std::size_t{64} * 1024> piece{};
    while (stream) {
        stream.read(piece.data(), piece.size());
        if (!take({piece.data(), static_cast<std::size_t>(stream.gcount())})) return false;
    }
    return stream.eof() && !stream.bad();
}

}  // namespace

ProfileText::ProfileText(std::string bytes) : m_bytes(std::move(bytes)) {}

ProfileText ProfileText::toBeChanged() const {
    constexpr std::size_t kRoom = 1024;
    ProfileText copy;
    copy.m_bytes.reserve(m_bytes.size() + kRoom);
    copy.m_bytes = m_bytes;
    copy.m_index = m_index;
    return copy;
}

const ProfileIndex& ProfileText::index() const {
    if (!m_index) m_index = std::make_shared<const ProfileIndex>(m_bytes);
    return *m_index;
}

std::string ProfileText::value(std::string_view section, std::string_view key, std::size_t longest) const {
    const auto line = index().key(m_bytes, trimmed(section), trimmed(key));
    return line ? valueOf(textOf(m_bytes, *line), longest) : std::string();
}

bool ProfileText::holds(std::string_view section, std::string_view key, std::string_view value) const {
    const auto line = index().key(m_bytes, trimmed(section), trimmed(key));
    if (!line || line->next == line->end) return false;
    const std::string_view text = std::string_view(m_bytes).substr(line->begin, line->end - line->begin);
    return text == assignment(keyOf(text), value);
}

bool ProfileText::anyKey(std::string_view section, const std::function<bool(std::string_view key)>& wanted) const {
    const auto header = index().header(m_bytes, trimmed(section));
    if (!header) return false;
    ProfileLine line;
    for (ProfileLines lines(m_bytes, header->next); lines.next(line);) {
        const std::string_view text = textOf(m_bytes, line);
        if (isHeader(text)) break;
        if (!saysNothing(text) && wanted(keyOf(text))) return true;
    }
    return false;
}

std::map<std::string, std::string> ProfileText::section(std::string_view name) const {
    std::map<std::string, std::string> values;
    (void)anyKey(name, [&](std::string_view key) {
        values.emplace(key, value(name, key));
        return false;
    });
    return values;
}

void ProfileText::setValue(std::string_view section, std::string_view key, std::string_view value) {
    section = trimmed(section);
    key = trimmed(key);
    if (const auto line = index().key(m_bytes, section, key)) {
        std::string replaced = assignment(keyOf(textOf(m_bytes, *line)), value);  // the key keeps its spelling
        if (line->next == line->end) replaced += kLineEnd;                        // the file's last line had none
        m_bytes.replace(line->begin, line->end - line->begin, replaced);
        m_index.reset();
    } else {
        const auto header = index().header(m_bytes, section);
        std::string added = assignment(key, value).append(kLineEnd);
        if (!header) added.insert(0, std::string("[").append(section).append("]").append(kLineEnd));
        const std::size_t at = header ? endOfKeys(m_bytes, *header) : m_bytes.size();
        if (at > firstLine(m_bytes) && !isLineEnd(m_bytes[at - 1])) added.insert(0, kLineEnd);
        // At the end, as in a file that says nothing yet, every other line stays where it was found.
        const auto longer = at == m_bytes.size() ? std::make_shared<ProfileIndex>(index()) : nullptr;
        m_bytes.insert(at, added);
        if (longer) longer->addLines(m_bytes, at);
        m_index = longer;
    }
}

bool isUtf16(std::string_view bytes) {
    return bytes.starts_with("\xFF\xFE") || bytes.starts_with("\xFE\xFF");
}

std::optional<std::string> readFile(const std::filesystem::path& file, std::uintmax_t most) {
    std::string bytes;
    std::error_code error;
    const std::uintmax_t size = std::filesystem::file_size(file, error);
    if (!error && size > most) return std::nullopt;
    if (!error) bytes.reserve(size + 1);
    const bool read = readPieces(file, [&](std::string_view piece) {
        if (piece.size() > most - bytes.size()) return false;
        bytes.append(piece);
        return true;
    });
    return read ? std::optional(std::move(bytes)) : std::nullopt;
}

bool fileHolds(const std::filesystem::path& file, std::string_view bytes) {
    const bool begins = readPieces(file, [&](std::string_view piece) {
        const bool equal = bytes.starts_with(piece);
        if (equal) bytes.remove_prefix(piece.size());
        return equal;
    });
    return begins && bytes.empty();
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
