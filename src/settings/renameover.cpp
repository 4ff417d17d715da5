#include "settings/renameover.h"

#include "base/clock.h"

namespace kdx {

bool renameOver(const std::filesystem::path& from, const std::filesystem::path& to, Clock& clock,
                const Rename& rename) {
    using namespace std::chrono_literals;
    const auto latest = clock.steadyNow() + 200ms;
    for (;;) {
        std::error_code error;
        rename(from, to, error);
        // No matter of rights: the file could be written beside the other.
        if (error != std::errc::permission_denied || clock.steadyNow() >= latest) return !error;
        clock.sleep(10ms);
    }
}

}  // namespace kdx
