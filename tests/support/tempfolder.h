#pragma once

#include <atomic>
#include <cstdlib>
#include <filesystem>
#include <fstream>
#include <iterator>
#include <string>

#include <unistd.h>

#include "support/sourcefolder.h"

namespace kdx::test {

/// A program folder with an empty "Daten" of its own, gone with the test.
class TempFolder {
public:
    TempFolder() {
        static std::atomic<int> count = 0;
        m_path = std::filesystem::temp_directory_path() /
                 ("kdx-test-" + std::to_string(getpid()) + "-" + std::to_string(count++));
        std::filesystem::remove_all(m_path);  // of a test of the same number that was killed
        std::filesystem::create_directories(data());
    }
    ~TempFolder() {
        std::error_code ignored;
        std::filesystem::permissions(data(), std::filesystem::perms::owner_all, ignored);
        // Where a file that is marked read-only cannot be removed.
        for (const auto& entry : std::filesystem::directory_iterator(data(), ignored)) {
            if (entry.is_regular_file(ignored) && !entry.is_symlink(ignored))
                std::filesystem::permissions(entry.path(), std::filesystem::perms::owner_all, ignored);
        }
        std::filesystem::remove_all(m_path, ignored);
    }
    TempFolder(const TempFolder&) = delete;
    TempFolder& operator=(const TempFolder&) = delete;

    [[nodiscard]] const std::filesystem::path& path() const { return m_path; }
    [[nodiscard]] std::filesystem::path data() const { return m_path / "Daten"; }
    void write(const std::string& name, const std::string& bytes) const {
        std::ofstream(data() / name, std::ios::binary) << bytes;
    }
    [[nodiscard]] std::string read(const std::string& name) const {
        std::ifstream file(data() / name, std::ios::binary);
        return {std::istreambuf_iterator<char>(file), {}};
    }
    /// Whether files can be there whose names differ in letter case only.
    [[nodiscard]] bool tellsLetterCaseApart() const {
        std::ofstream(m_path / "kdx-case") << "";
        const bool apart = !std::filesystem::exists(m_path / "KDX-CASE");
        std::filesystem::remove(m_path / "kdx-case");
        return apart;
    }
    /// Copies the shipped data folder.
    void copyShipped() const {
        std::filesystem::copy(
            sourceFolder() / "Daten", data(),
            std::filesystem::copy_options::recursive | std::filesystem::copy_options::overwrite_existing);
        std::filesystem::remove(data() / "RDS_log.txt");  // of whoever tried the programs on that folder
    }

private:
    std::filesystem::path m_path;
};

}  // namespace kdx::test
