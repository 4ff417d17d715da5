#pragma once

#include <cstddef>
#include <string>
#include <string_view>
#include <utility>
#include <vector>

namespace kdx {

/// What a command log holds.
struct LoggedCommands {
    /// Keys and commands in their order. Questions and answers are no commands.
    std::vector<std::pair<std::string, std::string>> commands;
    /// Lines, counted from 1, with a command whose text for the coder a double quote ends early.
    std::vector<std::size_t> quotedLines;
    /// Lines, counted from 1, that no program of ours has written, or that are not whole.
    std::vector<std::size_t> unreadableLines;
};

/// Takes a command log apart: a line is the key right-aligned in 15 characters, "= ", a value, and a note in double
/// quotes unless it is empty. The note of a sent parameter is its command; lines with a value are questions, answers
/// and what was shown. Lines end with CR LF or LF. Texts are 8-bit Windows-1252.
[[nodiscard]] LoggedCommands readLoggedCommands(std::string_view log);

}  // namespace kdx
