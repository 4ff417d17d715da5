#include "settings/profilelines.h"

#include <algorithm>

namespace kdx {

namespace {

bool isBlank(char c) {
    return c == ' ' || c == '\t' || c == '\v';
}

/// @param end where the line's text ends: at a line end, or with the bytes.
ProfileLine lineFrom(std::string_view bytes, std::size_t begin, std::size_t end) {
    const bool twoBytes = bytes.substr(end).starts_with("\r\n");
    return {begin, end, twoBytes ? end + 2 : std::min(end + 1, bytes.size())};
}

}  // namespace

ProfileLine lineAt(std::string_view bytes, std::size_t begin) {
    return lineFrom(bytes, begin, std::min(bytes.find_first_of("\r\n", begin), bytes.size()));
}

bool ProfileLines::next(ProfileLine& line) {
    if (m_at >= m_bytes.size()) return false;
    // Looked for once each: a file with one kind of line end would else be searched to its end for every line.
    if (m_nextCr < m_at || m_at == 0) m_nextCr = std::min(m_bytes.find('\r', m_at), m_bytes.size());
    if (m_nextLf < m_at || m_at == 0) m_nextLf = std::min(m_bytes.find('\n', m_at), m_bytes.size());
    line = lineFrom(m_bytes, m_at, std::min(m_nextCr, m_nextLf));
    m_at = line.next;
    return true;
}

std::size_t firstLine(std::string_view bytes) {
    constexpr std::string_view kUtf8Mark = "\xEF\xBB\xBF";
    return bytes.starts_with(kUtf8Mark) ? kUtf8Mark.size() : 0;
}

std::string_view trimmed(std::string_view text) {
    while (!text.empty() && isBlank(text.front())) text.remove_prefix(1);
    while (!text.empty() && isBlank(text.back())) text.remove_suffix(1);
    return text;
}

std::string_view textOf(std::string_view bytes, const ProfileLine& line) {
    return trimmed(bytes.substr(line.begin, line.end - line.begin));
}

bool saysNothing(std::string_view lineText) {
    return lineText.empty() || lineText.front() == ';';
}

bool isHeader(std::string_view lineText) {
    return lineText.starts_with('[');
}

std::string_view sectionOf(std::string_view header) {
    return trimmed(header.substr(1, header.find(']') - 1));
}

std::string_view keyOf(std::string_view lineText) {
    return trimmed(lineText.substr(0, lineText.find('=')));
}

}  // namespace kdx
