#include <system_error>

#include "base/clock.h"
#include "settings/durablefile.h"
#include "settings/leftovers.h"
#include "settings/profilefile.h"
#include "settings/renameover.h"

namespace kdx {

namespace {

namespace fs = std::filesystem;

constexpr int kLongestLinkChain = 40;

/// Where a chain of symbolic links ends, whether or not something is there; nothing when it runs in a circle.
std::optional<fs::path> linkTarget(fs::path file) {
    for (int links = 0; links < kLongestLinkChain; ++links) {
        std::error_code error;
        if (!fs::is_symlink(fs::symlink_status(file, error))) return file;
        const fs::path target = fs::read_symlink(file, error);
        if (error) return std::nullopt;
        file = file.parent_path() / target;  // an absolute target replaces the folder
    }
    return std::nullopt;
}

/// A file that is not there yet, or a plain file that is not marked read-only. The mark counts for every user, for
/// whom the permissions do not count otherwise as well.
bool mayBeReplaced(const fs::path& file) {
    std::error_code error;
    const fs::file_status status = fs::status(file, error);
    if (status.type() == fs::file_type::not_found) return true;
    constexpr auto kAnyWrite = fs::perms::owner_write | fs::perms::group_write | fs::perms::others_write;
    return fs::is_regular_file(status) && (status.permissions() & kAnyWrite) != fs::perms::none && userMayWrite(file);
}

}  // namespace

bool replaceFile(const fs::path& file, std::string_view bytes) {
    const std::optional<fs::path> target = linkTarget(file);
    if (!target || !mayBeReplaced(*target)) return false;
    const fs::path beside = nameBeside(*target);
    std::error_code error;
    if (writeNewFile(beside, bytes, *target)) {
        SystemClock clock;
        if (renameOver(beside, *target, clock, renameFile)) {
            flushFolder(target->parent_path());
            return true;
        }
    }
    fs::remove(beside, error);
    return false;
}

}  // namespace kdx
