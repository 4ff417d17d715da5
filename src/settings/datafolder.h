#pragma once

#include <filesystem>
#include <functional>
#include <memory>
#include <optional>
#include <string>
#include <string_view>
#include <vector>

#include "settings/profilecache.h"

namespace kdx {

inline constexpr const char* kGeneralSettings = "RDS_Allg.INI";
inline constexpr const char* kLanguageFile = "Sprachen.ini";
inline constexpr const char* kCommandLog = "RDS_log.txt";
inline constexpr const char* kEventList = "Event.txt";
inline constexpr const char* kLocationList = "Location.txt";
inline constexpr const char* kPictureOn = "Sch_On.ico";
inline constexpr const char* kPictureOff = "Sch_Off.ico";

/// "Datenset" + number + ".INI".
[[nodiscard]] std::string dataSetFile(std::string_view number);

/// The data folder ("Daten" in the program's folder): finds its files without regard to letter case on every system,
/// and reads and writes settings in its profile files. Texts are 8-bit Windows-1252.
class DataFolder {
public:
    /// @param appFolder the program's folder; the data are in its sub-folder "Daten" (any letter case).
    explicit DataFolder(const std::filesystem::path& appFolder);

    /// The data folder itself; it need not exist.
    [[nodiscard]] const std::filesystem::path& path() const { return m_path; }

    /// Where a file of the given name is: a file whose name differs in letter case only is found too; one spelled
    /// exactly so wins. When there is none, the path it would be created at.
    [[nodiscard]] std::filesystem::path file(const std::filesystem::path& name) const;

    /// One value; "" when the key, the section or the file is missing, unreadable or the value is empty. Values are
    /// cut at 254 characters. Never creates a file, never throws.
    [[nodiscard]] std::string ReadIni(std::string_view section, std::string_view key, std::string_view fileName) const;

    /// All settings of a file as they are now; nothing when it is missing or cannot be read.
    [[nodiscard]] std::shared_ptr<const ProfileText> profile(std::string_view fileName) const;

    /// Writes one key at once; creates the file and the section if needed. A failure changes nothing on disk, throws
    /// nothing and opens no box: it is kept in unsavedFile() until a write to the same file succeeds.
    void WriteIni(std::string_view section, std::string_view key, std::string_view value, std::string_view fileName);

    /// Name of the file that could not be written last and has not been written since; nothing when all is saved.
    [[nodiscard]] std::optional<std::string> unsavedFile() const;

    /// Called whenever unsavedFile() changes.
    void onUnsavedFileChanged(std::function<void()> callback) { m_unsavedFileChanged = std::move(callback); }

private:
    void noteSaved(std::string_view fileName, bool saved);

    std::filesystem::path m_path;
    mutable ProfileCache m_profiles;
    std::vector<std::string> m_unsavedFiles;  // the one that failed last at the end
    std::function<void()> m_unsavedFileChanged;
};

}  // namespace kdx
