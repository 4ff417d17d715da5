#include "base/codepage.h"

#include <algorithm>
#include <array>

#include "base/printable.h"

namespace kdx {

namespace {

// Bytes 80 to 9F of Windows-1252; all others equal their Unicode code points.
constexpr std::array<char16_t, 32> kHighControls = {0x20AC, 0x0081, 0x201A, 0x0192, 0x201E, 0x2026, 0x2020, 0x2021,
                                                    0x02C6, 0x2030, 0x0160, 0x2039, 0x0152, 0x008D, 0x017D, 0x008F,
                                                    0x0090, 0x2018, 0x2019, 0x201C, 0x201D, 0x2022, 0x2013, 0x2014,
                                                    0x02DC, 0x2122, 0x0161, 0x203A, 0x0153, 0x009D, 0x017E, 0x0178};

int byteOf(char16_t codePoint) {
    if (codePoint < 0x80 || (codePoint >= 0xA0 && codePoint <= 0xFF)) return codePoint;
    const auto* found = std::find(kHighControls.begin(), kHighControls.end(), codePoint);
    return found == kHighControls.end() ? -1 : 0x80 + static_cast<int>(found - kHighControls.begin());
}

char upper(char c) {
    const auto byte = static_cast<unsigned char>(c);
    if (byte >= 'a' && byte <= 'z') return static_cast<char>(byte - 0x20);
    if (byte >= 0xE0 && byte <= 0xFE && byte != 0xF7) return static_cast<char>(byte - 0x20);  // F7 is the division sign
    if (byte == 0x9A || byte == 0x9C || byte == 0x9E) return static_cast<char>(byte - 0x10);
    if (byte == 0xFF) return static_cast<char>(0x9F);
    return c;
}

bool isContinuation(char byte) {
    return (static_cast<unsigned char>(byte) & 0xC0U) == 0x80U;
}

}  // namespace

char16_t fromCodePage(unsigned char byte) {
    return byte >= 0x80 && byte < 0xA0 ? kHighControls[byte - 0x80] : static_cast<char16_t>(byte);
}

char toCodePage(char16_t codePoint) {
    const int byte = byteOf(codePoint);
    return byte < 0 ? '?' : static_cast<char>(byte);
}

std::string fromUtf8(std::string_view text) {
    std::string bytes;
    for (std::size_t at = 0; at < text.size();) {
        const auto lead = static_cast<unsigned char>(text[at]);
        // How many bytes the character takes: those of 4 lie beyond the code page, like everything malformed.
        const std::size_t length = lead < 0x80 ? 1 : lead >= 0xF0 ? 4 : lead >= 0xE0 ? 3 : lead >= 0xC2 ? 2 : 0;
        std::size_t got = length == 0 ? 0 : 1;
        unsigned code = length == 1 ? lead : lead & (0x7FU >> length);
        for (; got < length && at + got < text.size(); ++got) {
            const auto next = static_cast<unsigned char>(text[at + got]);
            if (!isContinuation(text[at + got])) break;
            code = code << 6U | (next & 0x3FU);
        }
        const bool whole = length > 0 && got == length && code <= 0xFFFF;
        bytes += whole ? toCodePage(static_cast<char16_t>(code)) : '?';
        at += got == 0 ? 1 : got;
    }
    return bytes;
}

std::size_t characterCount(std::string_view utf8) {
    return utf8.size() - static_cast<std::size_t>(std::count_if(utf8.begin(), utf8.end(), isContinuation));
}

std::size_t characterLength(std::string_view utf8) {
    if (utf8.empty()) return 0;
    const auto first = static_cast<unsigned char>(utf8.front());
    if (first < 0x80) return 1;
    const std::size_t length = first >= 0xF0 ? 4 : first >= 0xE0 ? 3 : 2;
    if (first < 0xC2 || first > 0xF4 || utf8.size() < length) return 0;
    if (!std::all_of(utf8.begin() + 1, utf8.begin() + static_cast<std::ptrdiff_t>(length), isContinuation)) return 0;
    // The shortest form only, no halves of pairs, nothing beyond the last code point.
    const auto second = static_cast<unsigned char>(utf8[1]);
    const bool wrong = (first == 0xE0 && second < 0xA0) || (first == 0xED && second > 0x9F) ||
                       (first == 0xF0 && second < 0x90) || (first == 0xF4 && second > 0x8F);
    return wrong ? 0 : length;
}

std::string_view firstOutsideCodePage(std::string_view utf8) {
    while (!utf8.empty()) {
        const std::string_view character = utf8.substr(0, std::max<std::size_t>(characterLength(utf8), 1));
        if (character != "?" && fromUtf8(character) == "?") return character;
        utf8.remove_prefix(character.size());
    }
    return {};
}

std::string noSuchCharacter(std::string_view foreign) {
    if (isUtf8(foreign)) return "the instrument's character set (Windows-1252) has no " + std::string(foreign);
    return "its byte " + printable(foreign) + " is no UTF-8";
}

bool isUtf8(std::string_view text) {
    while (!text.empty()) {
        const std::size_t length = characterLength(text);
        if (length == 0) return false;
        text.remove_prefix(length);
    }
    return true;
}

std::string toUtf8(std::string_view text) {
    std::string utf8;
    for (const char c : text) {
        const auto code = static_cast<unsigned>(fromCodePage(static_cast<unsigned char>(c)));
        if (code < 0x80) {
            utf8 += c;
        } else if (code < 0x800) {
            utf8 += {static_cast<char>(0xC0U | code >> 6U), static_cast<char>(0x80U | (code & 0x3FU))};
        } else {
            utf8 += {static_cast<char>(0xE0U | code >> 12U), static_cast<char>(0x80U | (code >> 6U & 0x3FU)),
                     static_cast<char>(0x80U | (code & 0x3FU))};
        }
    }
    return utf8;
}

bool inCodePage(char16_t codePoint) {
    return byteOf(codePoint) >= 0;
}

std::string upperCase(std::string_view text) {
    std::string result(text);
    std::transform(result.begin(), result.end(), result.begin(), upper);
    return result;
}

bool equalNoCase(std::string_view left, std::string_view right) {
    return left.size() == right.size() &&
           std::equal(left.begin(), left.end(), right.begin(), [](char a, char b) { return upper(a) == upper(b); });
}

}  // namespace kdx
