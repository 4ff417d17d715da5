#include <chrono>
#include <system_error>
#include <thread>

#include "settings/folderlock.h"

namespace kdx {

namespace {

namespace fs = std::filesystem;
using namespace std::chrono_literals;

/// Only one program can make a folder of a name. One that is older than any work takes was left by a crash.
bool isLeftOver(const fs::path& mark) {
    std::error_code error;
    const fs::file_time_type made = fs::last_write_time(mark, error);
    return !error && fs::file_time_type::clock::now() - made > 10s;
}

}  // namespace

bool underFolderLock(const fs::path& folder, const std::function<void()>& work) {
    const fs::path mark = folder / ".kdx-rds-lock";
    const auto latest = std::chrono::steady_clock::now() + 1s;
    std::error_code error;
    bool made = false;
    // A mark that goes away while it is looked at is told as an existing file: its owner has just let go.
    while (!(made = fs::create_directory(mark, error)) && (!error || error == std::errc::file_exists)) {
        if (std::chrono::steady_clock::now() >= latest) return false;
        if (isLeftOver(mark)) fs::remove(mark, error);
        std::this_thread::sleep_for(1ms);
    }
    work();
    if (made) fs::remove(mark, error);
    return true;
}

}  // namespace kdx
