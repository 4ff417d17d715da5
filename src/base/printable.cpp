#include "base/printable.h"

#include <algorithm>

namespace kdx {

std::string printable(std::string_view text) {
    constexpr std::string_view kDigits = "0123456789ABCDEF";
    std::string result;
    for (const char c : text) {
        const auto byte = static_cast<unsigned char>(c);
        if (c == '\n') {
            result += "\\n";
        } else if (c == '\r') {
            result += "\\r";
        } else if (isControl(c) || byte >= 0x80) {
            result += {'\\', 'x', kDigits[byte >> 4U], kDigits[byte & 0xFU]};
        } else {
            result += c;
        }
    }
    return result;
}

std::string printable(std::string_view text, char substitute) {
    std::string result(text);
    std::replace_if(
        result.begin(), result.end(), [](char c) { return static_cast<unsigned char>(c) < 0x20; }, substitute);
    return result;
}

std::string printableLine(std::string_view text, char substitute) {
    return printable(text.substr(0, text.find_last_not_of(" \n") + 1), substitute);
}

}  // namespace kdx
