#pragma once

#include <string>
#include <string_view>

namespace kdx {

/// Whether the byte is a control character of ASCII.
[[nodiscard]] constexpr bool isControl(char c) {
    const auto byte = static_cast<unsigned char>(c);
    return byte < 0x20 || byte == 0x7F;
}

/// The text as visible characters of ASCII, so that a line stays a line on any terminal: line feed and carriage return
/// as \n and \r, other control characters and everything above ASCII as \x and two hexadecimal digits.
[[nodiscard]] std::string printable(std::string_view text);

/// The text with each control character (below 20) replaced by the substitute, so that a line stays a line where the
/// code page's characters can be shown.
[[nodiscard]] std::string printable(std::string_view text, char substitute);

/// The same for an answer or a command: blanks at its end, which only pad it, and the line feed after them are left
/// out.
[[nodiscard]] std::string printableLine(std::string_view text, char substitute);

}  // namespace kdx
