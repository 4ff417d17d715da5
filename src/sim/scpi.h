#pragma once

#include <optional>
#include <string>
#include <string_view>
#include <vector>

#include "sim/errorqueue.h"

namespace kdx::sim {

/// One command of a program message, cut into its pieces; the views point into the message.
struct CommandUnit {
    std::string_view header;     ///< without question mark; a leading colon is still there
    bool query = false;          ///< a question mark followed the header
    bool separated = true;       ///< white space stood before the parameter, as it should
    std::string_view parameter;  ///< without the blanks around it
};

/// Follows a text character by character and knows which of them stand in a string, in double quotes or single ones.
class Quotes {
public:
    /// True when the character stands inside quotes (the closing one counts as outside).
    bool take(char c);

private:
    char m_open = '\0';
};

/// Cuts a text at the separator, except inside quotes. An unclosed quote takes in the rest of the text.
[[nodiscard]] std::vector<std::string_view> splitOutsideQuotes(std::string_view text, char separator);

/// Cuts a text at the first separator: what stands before it, and what stands after it (nothing without one).
struct HeadAndTail {
    std::string_view head;
    std::optional<std::string_view> tail;
};
[[nodiscard]] HeadAndTail cutAt(std::string_view text, char separator);

/// The text without white space at both ends: blanks and every control character.
[[nodiscard]] std::string_view trimmed(std::string_view text);

/// Cuts one command after its header.
[[nodiscard]] CommandUnit readUnit(std::string_view unit);

/// True when the header fits the pattern in any letter case, each of its words in the long form or in the short one.
/// @param pattern words joined by colons, their short form in capitals: "STEReo:PILot:STATe".
/// @param header with or without a leading colon.
[[nodiscard]] bool headerMatches(std::string_view pattern, std::string_view header);

/// True when the word is the pattern's long form or its short one, in any letter case.
[[nodiscard]] bool wordMatches(std::string_view pattern, std::string_view word);

/// What is wrong with a command that takes at most one parameter, before that one is looked at: the separator in front
/// of it, or a second one behind it.
[[nodiscard]] ScpiError checkOneParameter(const CommandUnit& unit);

/// What is wrong with a parameter that is no number, no word that belongs there, or no whole string: it may be two
/// without a comma between them. The same for the suffix of a number that is none.
[[nodiscard]] ScpiError errorOfValue(std::string_view parameter);
[[nodiscard]] ScpiError errorOfSuffix(std::string_view suffix);
[[nodiscard]] ScpiError errorOfString(std::string_view parameter);

/// The text inside a parameter in double or single quotes; a doubled quote stands for one. Nothing when the quotes are
/// missing or do not close at the end of the parameter.
[[nodiscard]] std::optional<std::string> unquoted(std::string_view parameter);

/// The text in double quotes, its own quotes doubled.
[[nodiscard]] std::string quoted(std::string_view text);

/// A decimal number and what follows it, blanks between them left out.
struct NumberWithSuffix {
    double value = 0;  ///< infinite when it is too large to be held, 0 when it is too small
    std::string_view suffix;
};
/// Nothing when the text does not begin with a number. The decimal separator is the point whatever the locale.
[[nodiscard]] std::optional<NumberWithSuffix> readNumber(std::string_view text);

/// A whole number that fills the text but for blanks around it; nothing when it is anything else.
[[nodiscard]] std::optional<int> readWhole(std::string_view text);

/// True when the text has a control character in it, which neither the air nor an answer could carry.
[[nodiscard]] bool hasControlCharacter(std::string_view text);

}  // namespace kdx::sim
