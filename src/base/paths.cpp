#include "base/paths.h"

#include <system_error>

#include "base/codepage.h"

namespace kdx {

namespace fs = std::filesystem;

namespace {

constexpr bool kNamesAreBytes = sizeof(fs::path::value_type) == 1;

}  // namespace

fs::path pathFromUtf8(std::string_view name) {
    if constexpr (kNamesAreBytes) {
        return {name.begin(), name.end()};
    } else {
        const std::string text = isUtf8(name) ? std::string(name) : toUtf8(name);
        return {std::u8string(text.begin(), text.end())};
    }
}

std::string utf8Of(const fs::path& path) {
    if constexpr (kNamesAreBytes) {
        return {path.native().begin(), path.native().end()};
    } else {
        try {
            const std::u8string text = path.u8string();
            return {text.begin(), text.end()};
        } catch (const std::system_error&) {
            return "?";  // half a surrogate pair
        }
    }
}

}  // namespace kdx
