#pragma once

#include <cstddef>
#include <string_view>

namespace kdx {

/// What the reading rules make of a profile file's bytes, line by line.

/// One line in the bytes: its text is [begin, end), the next line starts at `next`.
struct ProfileLine {
    std::size_t begin = 0;
    std::size_t end = 0;
    std::size_t next = 0;
};

/// The line that begins there.
[[nodiscard]] ProfileLine lineAt(std::string_view bytes, std::size_t begin);

/// Walks over the lines in one pass, however the lines end.
class ProfileLines {
public:
    ProfileLines(std::string_view bytes, std::size_t begin) : m_bytes(bytes), m_at(begin) {}

    /// False when there is no further line.
    [[nodiscard]] bool next(ProfileLine& line);

private:
    std::string_view m_bytes;
    std::size_t m_at;
    std::size_t m_nextCr = 0;  // where the next one is, when that is not behind us already
    std::size_t m_nextLf = 0;
};

/// Where the first line begins: behind the mark with which some editors begin UTF-8 files. A file that such an editor
/// saved would lose its first section otherwise; its values are 8-bit text all the same.
[[nodiscard]] std::size_t firstLine(std::string_view bytes);

/// Without blanks, tabs and vertical tabs at either end.
[[nodiscard]] std::string_view trimmed(std::string_view text);

/// The line's text, trimmed.
[[nodiscard]] std::string_view textOf(std::string_view bytes, const ProfileLine& line);

/// An empty line or a comment.
[[nodiscard]] bool saysNothing(std::string_view lineText);

[[nodiscard]] bool isHeader(std::string_view lineText);

/// The name in a header's brackets; one without its closing bracket ends with the line.
[[nodiscard]] std::string_view sectionOf(std::string_view header);

/// The part before the first '='; a line without one is a key without a value.
[[nodiscard]] std::string_view keyOf(std::string_view lineText);

}  // namespace kdx
