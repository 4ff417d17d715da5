#pragma once

#include <optional>
#include <string>
#include <string_view>

namespace kdx {

/// The option that a stored text names: 0 for the text of `first`, 1 for the one after it, up to `last`; -1 (none) for
/// every other text, an empty one included.
[[nodiscard]] int storedOption(std::string_view text, int first, int last);

/// The option that a stored number names: 0 for the number `first`, up to `last`; -1 (none) for every other one. A text
/// counts with the number it begins with.
[[nodiscard]] int storedNumber(std::string_view text, int first, int last);

/// The entry of a list of `count` that a stored number means, counted from 0; -1 when the list has none such. A text
/// without a number means the first one.
[[nodiscard]] int storedEntry(std::string_view text, int count);

/// The text of a flag: "1" for a stored "1", else "0".
[[nodiscard]] std::string storedFlag(std::string_view text);

/// Whether a switch of the general settings is on: the stored text begins with the number 1.
[[nodiscard]] bool isSwitchedOn(std::string_view text);

/// Whether the stored text wants the session opened at the start: "AUTO" in any letter case.
[[nodiscard]] bool opensAtStart(std::string_view text);

/// The text as it is to be written so that the same text is read: reading takes off blanks at the edges, and one pair
/// of quotes.
[[nodiscard]] std::string quotedWhereNeeded(const std::string& text);

/// The position of a scroll bar for a stored text: the number it begins with (0 when none), rounded to a whole one and
/// kept within the range.
[[nodiscard]] int storedPosition(std::string_view text, int lowest, int highest);

/// The decimal number that the text is, blanks at its edges left out and a decimal comma taken for a point; nothing for
/// what is no such number as a whole.
[[nodiscard]] std::optional<std::string> decimalNumber(std::string_view text);

/// Whether an entered number lies strictly between the limits; both limits themselves are refused. All three are the
/// leading numbers of the texts, compared in single precision.
[[nodiscard]] bool liesBetween(std::string_view entered, std::string_view lower, std::string_view upper);

}  // namespace kdx
