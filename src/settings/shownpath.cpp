#include "settings/shownpath.h"

#include <algorithm>
#include <system_error>

#include "base/codepage.h"
#include "base/paths.h"
#include "base/printable.h"

namespace kdx {

std::string shownPath(const std::filesystem::path& path) {
    return shownText(utf8Of(path));
}

std::string shownText(std::string_view text) {
    constexpr std::string_view kDigits = "0123456789ABCDEF";
    std::string shown;
    for (std::string_view rest = text; !rest.empty();) {
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
