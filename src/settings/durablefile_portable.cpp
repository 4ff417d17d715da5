#include <chrono>
#include <fstream>
#include <system_error>

#include "settings/durablefile.h"

namespace kdx {

namespace {

bool isPlainOrMissing(const std::filesystem::path& file) {
    std::error_code error;
    const auto type = std::filesystem::symlink_status(file, error).type();
    return type == std::filesystem::file_type::regular || type == std::filesystem::file_type::not_found;
}

bool writePlainFile(const std::filesystem::path& file, std::string_view bytes, std::ios::openmode how) {
    if (!isPlainOrMissing(file)) return false;
    std::ofstream stream(file, std::ios::binary | how);
    stream.write(bytes.data(), static_cast<std::streamsize>(bytes.size()));
    stream.close();
    return !stream.fail();
}

std::int64_t nanoseconds(std::filesystem::file_time_type time) {
    return std::chrono::duration_cast<std::chrono::nanoseconds>(time.time_since_epoch()).count();
}

}  // namespace

std::optional<FileIdentity> identityOf(const std::filesystem::path& file) {
    std::error_code error;
    FileIdentity identity;
    identity.size = std::filesystem::file_size(file, error);
    if (error) return std::nullopt;
    identity.modified = nanoseconds(std::filesystem::last_write_time(file, error));
    return error ? std::nullopt : std::optional(identity);
}

bool isSettled(const FileIdentity& identity) {
    constexpr std::int64_t kCoarseSteps = 2'000'000'000;
    return nanoseconds(std::filesystem::file_time_type::clock::now()) - identity.modified > kCoarseSteps;
}

bool userMayWrite(const std::filesystem::path& file) {
    return std::ofstream(file, std::ios::binary | std::ios::app).is_open();  // opened for appending: nothing changes
}

bool writeNewFile(const std::filesystem::path& file, std::string_view bytes, const std::filesystem::path& model) {
    std::error_code error;
    if (std::filesystem::exists(file, error) || error) return false;
    std::ofstream stream(file, std::ios::binary);
    stream.write(bytes.data(), static_cast<std::streamsize>(bytes.size()));
    stream.close();
    if (!stream) return false;
    const std::filesystem::file_status modelStatus = std::filesystem::status(model, error);
    if (!std::filesystem::exists(modelStatus)) return true;
    std::filesystem::permissions(file, modelStatus.permissions(), error);
    return !error;
}

bool appendToPlainFile(const std::filesystem::path& file, std::string_view bytes) {
    return writePlainFile(file, bytes, std::ios::app);
}

bool emptyPlainFile(const std::filesystem::path& file) {
    return writePlainFile(file, {}, std::ios::trunc);
}

std::uint64_t processNumber() {
    return 0;
}

bool mayStillBeWritten(const std::filesystem::path& file, std::uint64_t) {
    constexpr std::chrono::minutes kLongestWrite{1};
    std::error_code error;
    const auto begun = std::filesystem::last_write_time(file, error);
    return error || std::filesystem::file_time_type::clock::now() - begun < kLongestWrite;
}

void flushFolder(const std::filesystem::path&) {}  // the standard library has no means for it

}  // namespace kdx
