#include "settings/shownpath.h"

#include <algorithm>
#include <string_view>
#include <system_error>

#include "base/codepage.h"
#include "base/printable.h"

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

bool isSameFile(const std::filesystem::path& one, const std::filesystem::path& other) {
    if (one.empty() || other.empty()) return false;
    std::error_code error;
    if (std::filesystem::equivalent(one, other, error)) return true;
    const auto whole = [&error](const std::filesystem::path& path) {
        return std::filesystem::weakly_canonical(std::filesystem::absolute(path, error), error);
    };
    return whole(one) == whole(other);
}

}  // namespace kdx
