#include <cstdlib>
#include <system_error>

#include "app/platform.h"

namespace kdx {

namespace {

/// The variable's text; empty when it is not set.
std::filesystem::path variable(const char* name) {
    const char* value = std::getenv(name);
    return value == nullptr ? std::filesystem::path() : std::filesystem::path(value);
}

}  // namespace

std::filesystem::path programFolder(const char* program) {
    std::error_code error;
    const auto self = std::filesystem::canonical("/proc/self/exe", error);
    return (error ? std::filesystem::absolute(program, error) : self).parent_path();
}

std::filesystem::path userFolder() {
    // The XDG base directory standard: a relative path there is to be ignored. One in HOME is of no more use.
    if (const std::filesystem::path data = variable("XDG_DATA_HOME"); data.is_absolute()) return data / "kdx-rds";
    const std::filesystem::path home = variable("HOME");
    return home.is_absolute() ? home / ".local" / "share" / "kdx-rds" : std::filesystem::path();
}

bool hasDisplay() {
    return !variable("DISPLAY").empty() || !variable("WAYLAND_DISPLAY").empty() || !variable("QT_QPA_PLATFORM").empty();
}

}  // namespace kdx
