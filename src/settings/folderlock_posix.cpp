#include <fcntl.h>
#include <sys/file.h>

#include <cerrno>
#include <chrono>
#include <thread>

#include "base/filedescriptor.h"
#include "settings/folderlock.h"

namespace kdx {

namespace {

// The folder itself is locked: no file is left behind, and replacing the files in it changes nothing about the lock.
FileDescriptor opened(const std::filesystem::path& folder) {
    return FileDescriptor(::open(folder.c_str(), O_RDONLY | O_DIRECTORY | O_CLOEXEC));
}

enum class Lock { Held, Impossible, TooLate };

/// Asks again and again instead of waiting in the system: a program that was stopped while it held the lock must not
/// stop this one as well. What it kept from being written is tried again later.
Lock lock(const FileDescriptor& folder) {
    using namespace std::chrono;
    constexpr seconds kLongest{1};
    constexpr microseconds kPause{100};
    const auto latest = steady_clock::now() + kLongest;
    while (::flock(folder.number(), LOCK_EX | LOCK_NB) != 0) {
        if (errno != EWOULDBLOCK && errno != EINTR) return Lock::Impossible;
        if (steady_clock::now() >= latest) return Lock::TooLate;
        std::this_thread::sleep_for(kPause);
    }
    return Lock::Held;
}

#ifdef F_OFD_SETLK
/// A claim is a lock for reading, which any number of programs can hold; who asks for one to write learns of them.
/// Other kinds of locks would be gone as soon as the program closes the folder anywhere.
struct flock claimLock(short kind) {
    struct flock wanted {};
    wanted.l_type = kind;
    wanted.l_whence = SEEK_SET;
    wanted.l_len = 1;
    return wanted;
}
#endif

}  // namespace

bool underFolderLock(const std::filesystem::path& folder, const std::function<void()>& work) {
    const FileDescriptor descriptor = opened(folder);
    if (descriptor.isOpen() && lock(descriptor) == Lock::TooLate) return false;
    work();
    return true;
}

struct FolderClaim::Held {
    FileDescriptor folder;
};

FolderClaim::FolderClaim(const std::filesystem::path& folder) : m_held(new Held{opened(folder)}) {
#ifdef F_OFD_SETLK
    struct flock claim = claimLock(F_RDLCK);
    if (::fcntl(m_held->folder.number(), F_OFD_SETLK, &claim) != 0) m_held->folder.close();
#endif
}

FolderClaim::~FolderClaim() = default;

bool FolderClaim::isShared() const {
#ifdef F_OFD_SETLK
    struct flock other = claimLock(F_WRLCK);
    return ::fcntl(m_held->folder.number(), F_OFD_GETLK, &other) == 0 && other.l_type != F_UNLCK;
#else
    return false;
#endif
}

}  // namespace kdx
