#pragma once

#include <filesystem>
#include <functional>
#include <memory>

namespace kdx {

/// What several programs on one data folder need of the operating system: folderlock_posix.cpp; on Windows
/// folderlock_portable.cpp and folderclaim_windows.cpp.

/// Runs the work while no other program runs such work for the same folder; it should take milliseconds. Where the
/// folder cannot be locked at all (it is missing, the disk has no locks) the work runs all the same.
/// @return false when another program kept the folder for too long: the work was not run.
[[nodiscard]] bool underFolderLock(const std::filesystem::path& folder, const std::function<void()>& work);

/// Lets other programs know, as long as it lives, that this one uses the folder. A program that crashed leaves nothing
/// behind that could be taken for a living one. Nothing is written to the folder.
class FolderClaim {
public:
    explicit FolderClaim(const std::filesystem::path& folder);
    ~FolderClaim();
    FolderClaim(const FolderClaim&) = delete;
    FolderClaim& operator=(const FolderClaim&) = delete;

    /// Whether another living program has claimed the folder; looked at anew each time. False where it cannot be told.
    [[nodiscard]] bool isShared() const;

private:
    struct Held;
    std::unique_ptr<Held> m_held;
};

}  // namespace kdx
