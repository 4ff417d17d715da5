#include <fcntl.h>
#include <sys/stat.h>
#include <unistd.h>

#include <algorithm>
#include <cerrno>
#include <csignal>
#include <ctime>
#include <limits>

#include "base/filedescriptor.h"
#include "settings/durablefile.h"

namespace kdx {

namespace {

bool writeAll(int file, std::string_view bytes) {
    while (!bytes.empty()) {
        const ssize_t written = ::write(file, bytes.data(), bytes.size());
        if (written < 0 && errno == EINTR) continue;
        if (written <= 0) return false;
        bytes.remove_prefix(static_cast<std::size_t>(written));
    }
    return true;
}

bool takeOver(int file, const struct stat& model) {
    if (::fchown(file, model.st_uid, model.st_gid) != 0) {
        // Only the administrator may give files away. Whoever may write another user's settings saves them under his
        // own name then, so that a shared data folder stays usable; the group is kept where he belongs to it.
        [[maybe_unused]] const int kept = ::fchown(file, static_cast<uid_t>(-1), model.st_gid);
    }
    return ::fchmod(file, model.st_mode & 07777) == 0;  // after the owner: a new owner clears bits of the mode
}

/// Not through a link, and without waiting for a reader of a pipe.
FileDescriptor openPlainFile(const std::filesystem::path& file) {
    constexpr mode_t kUsersMaskDecides = 0666;
    constexpr int kHow = O_WRONLY | O_APPEND | O_CREAT | O_NOFOLLOW | O_NONBLOCK | O_NOCTTY | O_CLOEXEC;
    FileDescriptor descriptor(::open(file.c_str(), kHow, kUsersMaskDecides));
    struct stat status {};
    if (descriptor.isOpen() && (::fstat(descriptor.number(), &status) != 0 || !S_ISREG(status.st_mode)))
        descriptor.close();
    return descriptor;
}

std::int64_t nanoseconds(const timespec& time) {
    constexpr std::int64_t kSecond = 1'000'000'000;
    return time.tv_sec * kSecond + time.tv_nsec;
}

}  // namespace

std::optional<FileIdentity> identityOf(const std::filesystem::path& file) {
    struct stat status {};
    if (::stat(file.c_str(), &status) != 0) return std::nullopt;
    return FileIdentity{status.st_dev, status.st_ino, static_cast<std::uint64_t>(status.st_size),
                        nanoseconds(status.st_mtim), nanoseconds(status.st_ctim)};
}

bool isSettled(const FileIdentity& identity) {
    constexpr std::int64_t kSecond = 1'000'000'000;
    constexpr std::int64_t kFineSteps = kSecond / 10;
    constexpr std::int64_t kCoarseSteps = 2 * kSecond;
    // A change at a whole second, to the nanosecond, means a disk that keeps no finer times.
    const bool coarse = identity.modified % kSecond == 0;
    timespec now{};
    ::clock_gettime(CLOCK_REALTIME, &now);
    return nanoseconds(now) - std::max(identity.modified, identity.changed) > (coarse ? kCoarseSteps : kFineSteps);
}

bool userMayWrite(const std::filesystem::path& file) {
    return ::faccessat(AT_FDCWD, file.c_str(), W_OK, AT_EACCESS) == 0;
}

bool writeNewFile(const std::filesystem::path& file, std::string_view bytes, const std::filesystem::path& model) {
    struct stat modelStatus {};
    const bool hasModel = ::stat(model.c_str(), &modelStatus) == 0;
    const mode_t mode = hasModel ? 0600 : 0666;  // a model's mode is set below; without one the user's mask decides
    FileDescriptor descriptor(::open(file.c_str(), O_WRONLY | O_CREAT | O_EXCL | O_CLOEXEC, mode));
    if (!descriptor.isOpen()) return false;
    if (!writeAll(descriptor.number(), bytes)) return false;
    if (hasModel && !takeOver(descriptor.number(), modelStatus)) return false;
    return ::fsync(descriptor.number()) == 0 && descriptor.close();
}

bool appendToPlainFile(const std::filesystem::path& file, std::string_view bytes) {
    FileDescriptor descriptor = openPlainFile(file);
    return descriptor.isOpen() && writeAll(descriptor.number(), bytes) && descriptor.close();
}

bool emptyPlainFile(const std::filesystem::path& file) {
    FileDescriptor descriptor = openPlainFile(file);
    return descriptor.isOpen() && ::ftruncate(descriptor.number(), 0) == 0 && descriptor.close();
}

std::uint64_t processNumber() {
    return static_cast<std::uint64_t>(::getpid());
}

bool mayStillBeWritten(const std::filesystem::path&, std::uint64_t process) {
    // The own number was another program's before; below 1, it would mean a group of processes.
    if (process == processNumber() || process < 1 || process > std::numeric_limits<pid_t>::max()) return false;
    return ::kill(static_cast<pid_t>(process), 0) == 0 || errno != ESRCH;
}

void renameFile(const std::filesystem::path& from, const std::filesystem::path& to, std::error_code& error) {
    std::filesystem::rename(from, to, error);
}

void flushFolder(const std::filesystem::path& folder) {
    const FileDescriptor descriptor(::open(folder.empty() ? "." : folder.c_str(), O_RDONLY | O_DIRECTORY | O_CLOEXEC));
    if (descriptor.isOpen()) ::fsync(descriptor.number());
}

}  // namespace kdx
