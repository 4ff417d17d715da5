#pragma once

#include <cstddef>
#include <filesystem>
#include <optional>
#include <string>
#include <string_view>
#include <vector>

namespace kdx {

/// Characters of an entry's text as the lists show it; its code follows.
inline constexpr std::size_t kListTextLength = 42;

/// A line of an event or location file as the lists show it: the text before the first semicolon, padded or cut to 42
/// characters, and what comes after it, in all 1000 characters at most: no entry is that long, and a file of garbage
/// must not keep the window laying out a line of a megabyte. Nothing for a line without a semicolon.
[[nodiscard]] std::optional<std::string> shownEntry(std::string_view line);

/// The entries of an event or location file. Each is put together when it is asked for: a file of a million lines is
/// there at once.
class TmcList {
public:
    TmcList() = default;
    explicit TmcList(std::string bytes);

    [[nodiscard]] std::size_t size() const { return m_lines.size(); }
    /// As the lists show it.
    [[nodiscard]] std::string operator[](std::size_t index) const;
    /// As it stands in the file, without its line end.
    [[nodiscard]] std::string_view line(std::size_t index) const;

private:
    struct Line {
        std::size_t begin = 0;
        std::size_t length = 0;
    };
    std::string m_bytes;
    std::vector<Line> m_lines;  // those with a semicolon
};

/// All entries of a file; nothing when it is missing or cannot be read.
[[nodiscard]] std::optional<TmcList> loadTmcList(const std::filesystem::path& file);

/// Adds the line text, semicolon, code at the file's end; creates the file when missing. The file is replaced in one
/// step, so it is whole whatever happens, and no other program changes it meanwhile. False on any failure, and then the
/// file is as it was.
[[nodiscard]] bool appendToTmcList(const std::filesystem::path& file, std::string_view text, std::string_view code);

/// Puts the line text, semicolon, code in the place of a line of the file; the others stay as they are.
/// @param line as it was read: false, too, when the file has another line there by now.
[[nodiscard]] bool changeInTmcList(const std::filesystem::path& file, std::size_t index, std::string_view line,
                                   std::string_view text, std::string_view code);
/// Takes a line out of the file, with its line end; likewise.
[[nodiscard]] bool removeFromTmcList(const std::filesystem::path& file, std::size_t index, std::string_view line);

}  // namespace kdx
