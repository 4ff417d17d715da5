#include "settings/shownpath.h"

#include <algorithm>
#include <cstdint>
#include <string_view>
#include <system_error>

namespace kdx {

namespace {

/// The bytes of a name: on POSIX systems the name itself, elsewhere its UTF-8 form.
std::string bytesOf(const std::filesystem::path& path) {
    if constexpr (sizeof(std::filesystem::path::value_type) == 1) {
        return {path.native().begin(), path.native().end()};
    } else {
        try {
            const std::u8string text = path.u8string();
            return {text.begin(), text.end()};
        } catch (const std::system_error&) {
            return "?";  // half a surrogate pair: no text in any encoding
        }
    }
}

bool isContinuation(char c) {
    return (static_cast<unsigned char>(c) & 0xC0U) == 0x80U;
}

/// Length of the UTF-8 character the text begins with; 0 when it begins with none. Only the shortest form counts, and
/// neither half a surrogate pair nor anything beyond the last code point is a character.
std::size_t characterLength(std::string_view text) {
    constexpr std::uint32_t kFirstSurrogate = 0xD800;
    constexpr std::uint32_t kLastSurrogate = 0xDFFF;
    constexpr std::uint32_t kLastCodePoint = 0x10FFFF;
    const auto lead = static_cast<unsigned char>(text.front());
    if (lead < 0x80) return 1;
    if (lead < 0xC2 || lead > 0xF4) return 0;
    const std::size_t length = lead < 0xE0 ? 2 : (lead < 0xF0 ? 3 : 4);
    if (text.size() < length) return 0;
    std::uint32_t codePoint = lead & (0x7FU >> length);
    for (const char c : text.substr(1, length - 1)) {
        if (!isContinuation(c)) return 0;
        codePoint = codePoint << 6U | (static_cast<unsigned char>(c) & 0x3FU);
    }
    const std::uint32_t smallest = length == 2 ? 0x80 : (length == 3 ? 0x800 : 0x10000);
    const bool surrogate = codePoint >= kFirstSurrogate && codePoint <= kLastSurrogate;
    return codePoint < smallest || surrogate || codePoint > kLastCodePoint ? 0 : length;
}

bool isControl(char c) {
    const auto byte = static_cast<unsigned char>(c);
    return byte < 0x20 || byte == 0x7F;
}

}  // namespace

std::string shownPath(const std::filesystem::path& path) {
    constexpr std::string_view kDigits = "0123456789ABCDEF";
    const std::string bytes = bytesOf(path);
    std::string shown;
    for (std::string_view rest = bytes; !rest.empty();) {
        const std::size_t length = isControl(rest.front()) ? 0 : characterLength(rest);
        if (length == 0) {
            const auto byte = static_cast<unsigned char>(rest.front());
            shown += {'\\', 'x', kDigits[byte >> 4U], kDigits[byte & 0xFU]};
        } else {
            shown += rest.substr(0, length);
        }
        rest.remove_prefix(std::max<std::size_t>(length, 1));
    }
    return shown;
}

}  // namespace kdx
