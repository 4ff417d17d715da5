#pragma once

#include <cstddef>
#include <string>
#include <string_view>

namespace kdx {

/// The code point of a Windows-1252 byte. The five bytes the code page leaves open (81, 8D, 8F, 90, 9D) map to the
/// control characters of the same number, so that every byte survives the way there and back.
[[nodiscard]] char16_t fromCodePage(unsigned char byte);

/// The Windows-1252 byte of a code point, or '?' where the code page has none.
[[nodiscard]] char toCodePage(char16_t codePoint);

/// UTF-8 text in Windows-1252; '?' for each character or stray byte that the code page does not have.
[[nodiscard]] std::string fromUtf8(std::string_view text);

/// How many bytes the UTF-8 character takes that the text begins with; 0 when it begins with none.
[[nodiscard]] std::size_t characterLength(std::string_view utf8);

/// Characters of a UTF-8 text.
[[nodiscard]] std::size_t characterCount(std::string_view utf8);

/// The first character of the UTF-8 text that the code page does not have, or a byte that belongs to none; empty when
/// fromUtf8() keeps the text whole. A part of the text.
[[nodiscard]] std::string_view firstOutsideCodePage(std::string_view utf8);

/// The sentence about it, in UTF-8.
[[nodiscard]] std::string noSuchCharacter(std::string_view foreign);

/// Whether the bytes are whole characters of UTF-8.
[[nodiscard]] bool isUtf8(std::string_view text);

/// Windows-1252 text in UTF-8.
[[nodiscard]] std::string toUtf8(std::string_view text);

/// True when the code page has a byte for the code point.
[[nodiscard]] bool inCodePage(char16_t codePoint);

/// Letters of the code page in upper case: A to Z and the accented letters; everything else unchanged.
[[nodiscard]] std::string upperCase(std::string_view text);

/// Compares 8-bit texts without regard to letter case, accented letters of the code page included.
[[nodiscard]] bool equalNoCase(std::string_view left, std::string_view right);

}  // namespace kdx
