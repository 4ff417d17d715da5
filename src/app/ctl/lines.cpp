#include "app/ctl/lines.h"

#include <array>
#include <string_view>
#include <utility>

#include "app/platform.h"
#include "base/codepage.h"

namespace kdx::ctl {

Line lineOf(std::string bytes) {
    if (bytes.ends_with('\r')) bytes.pop_back();
    if (bytes.find('\0') != std::string::npos) return {{}, "the line holds a NUL byte"};
    if (!isUtf8(bytes)) return {{}, "the line is not UTF-8"};
    return {std::move(bytes), {}};
}

std::optional<Line> PipedLines::next() {
    std::size_t seen = m_taken;
    for (;;) {
        if (const std::size_t end = m_bytes.find('\n', seen); end != std::string::npos) return take(end);
        if (m_bytes.size() - m_taken > kLongest) {
            m_tooLong = true;
            m_taken = m_bytes.size();
        }
        if (m_atEnd) return m_taken < m_bytes.size() || m_tooLong ? take(m_bytes.size()) : std::nullopt;
        m_bytes.erase(0, std::exchange(m_taken, 0));
        seen = m_bytes.size();
        std::array<char, 8192> piece;
        const auto got = readInput(piece, m_stop);
        if (!got) return std::nullopt;
        m_bytes.append(piece.data(), *got);
        m_atEnd = *got == 0;
    }
}

std::optional<Line> PipedLines::take(std::size_t end) {
    std::string bytes = m_bytes.substr(m_taken, end - m_taken);
    m_taken = std::min(end + 1, m_bytes.size());
    if (std::exchange(m_tooLong, false) || bytes.size() > kLongest)
        return Line{{}, "the line has more than " + std::to_string(kLongest) + " bytes"};
    return lineOf(std::move(bytes));
}

std::optional<std::vector<std::string>> wordsOf(const std::string& line) {
    constexpr std::string_view kBlanks = " \t";
    std::vector<std::string> words;
    bool inWord = false;
    for (std::size_t at = 0; at < line.size(); ++at) {
        const char c = line[at];
        if (kBlanks.find(c) != std::string_view::npos) {
            inWord = false;
            continue;
        }
        if (!inWord && c == '#') break;
        if (!inWord) words.emplace_back();
        inWord = true;
        if (c != '"' && c != '\'') {
            words.back() += c;
            continue;
        }
        const std::size_t end = line.find(c, at + 1);
        if (end == std::string::npos) return std::nullopt;
        words.back().append(line, at + 1, end - at - 1);
        at = end;
    }
    return words;
}

}  // namespace kdx::ctl
