#pragma once

#include <cstddef>
#include <string>
#include <string_view>
#include <vector>

#include "scenario/mistake.h"

namespace kdx::scenario {

/// A mistake and where it stands; lines and columns (in characters) count from 1. Texts are UTF-8.
struct Problem {
    std::size_t line = 1;
    std::size_t column = 1;
    std::string sentence;  ///< of kdx-ctl
    Mistake mistake = {};
    std::vector<std::string> words = {};  ///< what its sentence names
};

inline constexpr std::string_view kUtf8Mark = "\uFEFF";  ///< what a file in UTF-8 may begin with

/// The mistakes of a text as they are found. After many the rest is left out: they tell nothing new.
class Problems {
public:
    /// @param utf8 lent.
    explicit Problems(std::string_view utf8) : m_text(utf8) {}

    /// @param at the byte of the text at which the mistake stands.
    void add(std::size_t at, Mistake mistake, std::vector<std::string> words = {});
    [[nodiscard]] bool empty() const { return m_found.empty(); }
    /// All of them in the order of their places.
    [[nodiscard]] std::vector<Problem> inOrder() const;
    [[nodiscard]] std::string_view text() const { return m_text; }

private:
    std::string_view m_text;
    std::vector<Problem> m_found;
};

/// Adds what keeps the text from being read as lines of UTF-8: the first byte that is none, control characters, lines
/// indented with a tab.
void addForeignBytes(Problems& problems);

}  // namespace kdx::scenario
