#include <windows.h>

#include <algorithm>
#include <limits>
#include <utility>

#include "settings/durablefile.h"

namespace kdx {

namespace {

/// An open file, closed when this goes.
class File {
public:
    File(const std::filesystem::path& name, DWORD access, DWORD how, DWORD flags = 0)
        : m_handle(CreateFileW(name.c_str(), access, FILE_SHARE_READ | FILE_SHARE_WRITE | FILE_SHARE_DELETE, nullptr,
                               how, FILE_ATTRIBUTE_NORMAL | flags, nullptr)) {}
    ~File() { close(); }
    File(const File&) = delete;
    File& operator=(const File&) = delete;

    [[nodiscard]] HANDLE handle() const { return m_handle; }
    [[nodiscard]] bool isOpen() const { return m_handle != INVALID_HANDLE_VALUE; }
    bool close() { return isOpen() && CloseHandle(std::exchange(m_handle, INVALID_HANDLE_VALUE)) != 0; }
    [[nodiscard]] bool write(std::string_view bytes) const {
        while (!bytes.empty()) {
            DWORD written = 0;
            const auto most = static_cast<DWORD>(std::min<std::size_t>(bytes.size(), 1U << 30U));
            if (WriteFile(m_handle, bytes.data(), most, &written, nullptr) == 0 || written == 0) return false;
            bytes.remove_prefix(written);
        }
        return true;
    }

private:
    HANDLE m_handle;
};

/// Not through a link, and no device: NUL and the like open everywhere.
bool isPlain(const File& file) {
    BY_HANDLE_FILE_INFORMATION facts;
    return file.isOpen() && GetFileType(file.handle()) == FILE_TYPE_DISK &&
           GetFileInformationByHandle(file.handle(), &facts) != 0 &&
           (facts.dwFileAttributes & (FILE_ATTRIBUTE_REPARSE_POINT | FILE_ATTRIBUTE_DIRECTORY)) == 0;
}

std::uint64_t joined(DWORD high, DWORD low) {
    return std::uint64_t{high} << 32U | low;
}

/// Since 1970: the system counts steps of 100 nanoseconds since 1601, which would be too many nanoseconds.
std::int64_t nanoseconds(std::int64_t steps) {
    constexpr std::int64_t kBefore1970 = 116'444'736'000'000'000;
    return (steps - kBefore1970) * 100;
}

}  // namespace

std::optional<FileIdentity> identityOf(const std::filesystem::path& file) {
    const File opened(file, FILE_READ_ATTRIBUTES, OPEN_EXISTING, FILE_FLAG_BACKUP_SEMANTICS);  // folders too
    BY_HANDLE_FILE_INFORMATION facts;
    FILE_BASIC_INFO times;
    if (!opened.isOpen() || GetFileInformationByHandle(opened.handle(), &facts) == 0 ||
        GetFileInformationByHandleEx(opened.handle(), FileBasicInfo, &times, sizeof times) == 0) {
        return std::nullopt;
    }
    return FileIdentity{facts.dwVolumeSerialNumber, joined(facts.nFileIndexHigh, facts.nFileIndexLow),
                        joined(facts.nFileSizeHigh, facts.nFileSizeLow), nanoseconds(times.LastWriteTime.QuadPart),
                        nanoseconds(times.ChangeTime.QuadPart)};
}

bool isSettled(const FileIdentity& identity) {
    constexpr std::int64_t kSecond = 1'000'000'000;
    constexpr std::int64_t kFineSteps = kSecond / 10;
    constexpr std::int64_t kCoarseSteps = 2 * kSecond;
    // A change at a whole second, to the nanosecond, means a disk that keeps no finer times.
    const bool coarse = identity.modified % kSecond == 0;
    FILETIME now;
    GetSystemTimeAsFileTime(&now);
    const auto steps = static_cast<std::int64_t>(joined(now.dwHighDateTime, now.dwLowDateTime));
    return nanoseconds(steps) - std::max(identity.modified, identity.changed) > (coarse ? kCoarseSteps : kFineSteps);
}

bool userMayWrite(const std::filesystem::path& file) {
    // Whoever holds it at the moment says nothing about rights.
    return File(file, FILE_APPEND_DATA, OPEN_EXISTING).isOpen() || GetLastError() == ERROR_SHARING_VIOLATION;
}

bool writeNewFile(const std::filesystem::path& file, std::string_view bytes, const std::filesystem::path& /*model*/) {
    // Rights come from the folder, and a file that is marked read-only is never replaced: the model has nothing to
    // give.
    File created(file, GENERIC_WRITE, CREATE_NEW);
    return created.isOpen() && created.write(bytes) && FlushFileBuffers(created.handle()) != 0 && created.close();
}

bool appendToPlainFile(const std::filesystem::path& file, std::string_view bytes) {
    File opened(file, FILE_APPEND_DATA | FILE_READ_ATTRIBUTES, OPEN_ALWAYS, FILE_FLAG_OPEN_REPARSE_POINT);
    return isPlain(opened) && opened.write(bytes) && opened.close();
}

bool emptyPlainFile(const std::filesystem::path& file) {
    File opened(file, GENERIC_WRITE | FILE_READ_ATTRIBUTES, OPEN_ALWAYS, FILE_FLAG_OPEN_REPARSE_POINT);
    return isPlain(opened) && SetEndOfFile(opened.handle()) != 0 && opened.close();
}

std::uint64_t processNumber() {
    return GetCurrentProcessId();
}

bool mayStillBeWritten(const std::filesystem::path&, std::uint64_t process) {
    // The own number was another program's before.
    if (process == processNumber() || process < 1 || process > std::numeric_limits<DWORD>::max()) return false;
    const HANDLE found = OpenProcess(SYNCHRONIZE, FALSE, static_cast<DWORD>(process));
    if (found == nullptr) return GetLastError() == ERROR_ACCESS_DENIED;  // another user's
    const bool lives = WaitForSingleObject(found, 0) == WAIT_TIMEOUT;
    CloseHandle(found);
    return lives;
}

void renameFile(const std::filesystem::path& from, const std::filesystem::path& to, std::error_code& error) {
    error.clear();
    if (MoveFileExW(from.c_str(), to.c_str(), MOVEFILE_REPLACE_EXISTING | MOVEFILE_WRITE_THROUGH) != 0) return;
    const DWORD why = GetLastError();
    const bool held = why == ERROR_ACCESS_DENIED || why == ERROR_SHARING_VIOLATION || why == ERROR_LOCK_VIOLATION;
    error = std::make_error_code(held ? std::errc::permission_denied : std::errc::io_error);
}

void flushFolder(const std::filesystem::path&) {}  // the system keeps a log of names by itself

}  // namespace kdx
