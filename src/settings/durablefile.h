#pragma once

#include <cstdint>
#include <filesystem>
#include <optional>
#include <string_view>
#include <system_error>

namespace kdx {

/// What reading and replacing files needs of the operating system: durablefile_posix.cpp and durablefile_windows.cpp.

/// Tells whether a file is still the one it was: as far as the system knows, another file in its place or a change of
/// its content changes one of these. Times are nanoseconds.
struct FileIdentity {
    std::uint64_t device = 0;
    std::uint64_t number = 0;
    std::uint64_t size = 0;
    std::int64_t modified = 0;
    std::int64_t changed = 0;
    bool operator==(const FileIdentity&) const = default;
};

/// The identity of the file, or of the one a link leads to; nothing when it is missing or cannot be looked at.
[[nodiscard]] std::optional<FileIdentity> identityOf(const std::filesystem::path& file);

/// True when the file's last change is so long ago that the next one is sure to give it another identity: times go in
/// steps of some milliseconds, on some disks of two seconds.
[[nodiscard]] bool isSettled(const FileIdentity& identity);

/// True when the user who runs the program may write the existing file.
[[nodiscard]] bool userMayWrite(const std::filesystem::path& file);

/// Writes a file that must not exist yet and flushes it to disk; when `model` exists, gives it the same mode and, as
/// far as the user may, the same owner and group. False on any failure; a part of the file may then be left.
[[nodiscard]] bool writeNewFile(const std::filesystem::path& file, std::string_view bytes,
                                const std::filesystem::path& model);

/// Appends to a plain file, which is created when missing. False on any failure, and at once when a link, a pipe, a
/// device or a folder is in its place, which is then left alone.
[[nodiscard]] bool appendToPlainFile(const std::filesystem::path& file, std::string_view bytes);

/// Empties a plain file; otherwise as appendToPlainFile.
[[nodiscard]] bool emptyPlainFile(const std::filesystem::path& file);

/// The system's number of this process, which no other living one has; 0 where it is not known.
[[nodiscard]] std::uint64_t processNumber();

/// Whether another living process may still be writing the file, which the one of that number has begun.
[[nodiscard]] bool mayStillBeWritten(const std::filesystem::path& file, std::uint64_t process);

/// Renames a file onto another one. The error is permission_denied where a third program holds one of both at the
/// moment.
void renameFile(const std::filesystem::path& from, const std::filesystem::path& to, std::error_code& error);

/// Makes a rename in the folder last through a power cut, where the system can promise that.
void flushFolder(const std::filesystem::path& folder);

}  // namespace kdx
