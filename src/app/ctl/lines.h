#pragma once

#include <cstddef>
#include <optional>
#include <string>
#include <vector>

namespace kdx::ctl {

/// A line of input without its end. What is wrong with it as such stands in `problem`; its text is not to be used then.
struct Line {
    std::string text;
    std::string problem;
};

/// Where the lines of a shell come from.
class LineSource {
public:
    virtual ~LineSource() = default;
    /// Waits for the next line; nothing at the end of the input, or when the user wants to stop.
    virtual std::optional<Line> next() = 0;
};

/// The bytes of a line, its line feed left out, as a line: a carriage return at its end belongs to the line's end.
[[nodiscard]] Line lineOf(std::string bytes);

/// The lines of the standard input as they come through a pipe or from a file. However long a line is, only so much of
/// it is kept as a line may have.
class PipedLines final : public LineSource {
public:
    static constexpr std::size_t kLongest = 65536;

    /// @param stop a descriptor that is readable once the user wants to stop.
    explicit PipedLines(int stop) : m_stop(stop) {}
    std::optional<Line> next() override;

private:
    std::optional<Line> take(std::size_t end);

    int m_stop;
    std::string m_bytes;      ///< read and not given yet
    std::size_t m_taken = 0;  ///< so many of them are given by now
    bool m_tooLong = false;   ///< the beginning of the line under way was thrown away
    bool m_atEnd = false;
};

/// The words of a line: apart by blanks, text in double or single quotes as it stands, and nothing behind a word that
/// begins with #. Nothing when a quote is not closed.
[[nodiscard]] std::optional<std::vector<std::string>> wordsOf(const std::string& line);

}  // namespace kdx::ctl
