#pragma once

#include <filesystem>
#include <functional>
#include <memory>
#include <optional>
#include <string>
#include <string_view>
#include <utility>
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
/// and reads and writes settings in its profile files, also while other programs do. Texts are 8-bit Windows-1252,
/// names of files UTF-8; a file elsewhere is named with its whole path.
class DataFolder {
public:
    /// @param appFolder the program's folder; the data are in its sub-folder "Daten" (any letter case).
    explicit DataFolder(const std::filesystem::path& appFolder);

    /// The data folder itself; it need not exist.
    [[nodiscard]] const std::filesystem::path& path() const { return m_path; }
    /// Where a file of the given name is: a file whose name differs in letter case only is found too; one spelled
    /// exactly so wins. When there is none, the path it would be created at.
    [[nodiscard]] std::filesystem::path file(std::string_view name) const;

    /// One value; "" when the key, the section or the file is missing, unreadable or the value is empty. Values are
    /// cut at 254 characters. Never creates a file, never throws.
    [[nodiscard]] std::string ReadIni(std::string_view section, std::string_view key, std::string_view fileName) const;
    /// All settings of a file as they are now, unwritten ones included; nothing when it is missing or cannot be read.
    [[nodiscard]] std::shared_ptr<const ProfileText> profile(std::string_view fileName) const;

    /// Writes one key at once; creates the file and the section if needed. A failure changes nothing on disk, throws
    /// nothing and opens no box: the value is kept, is what a read gives meanwhile (but nothing for a folder), and goes
    /// with the next write to the same file or with retryUnsaved().
    void WriteIni(std::string_view section, std::string_view key, std::string_view value, std::string_view fileName);
    /// From now on nothing in the folder is written: values count as ones that cannot be.
    void setReadOnly() { m_readOnly = true; }
    [[nodiscard]] bool isReadOnly() const { return m_readOnly; }
    /// Whether what the user saves may go to that file: not into a folder that is only read, also not by a link.
    [[nodiscard]] bool mayWrite(const std::filesystem::path& file) const;
    /// Tries to write what could not be written so far, and looks again at what could not be read.
    void retryUnsaved();
    /// Name of the file that could not be written last and still lacks a value; nothing when all is saved.
    [[nodiscard]] std::optional<std::string> unsavedFile() const;
    /// Name of the file last found to be there but without settings that can be read: UTF-16 text, a folder, a file
    /// without rights. Such a file is never written. The one of unsavedFile() is left out: it is told as that.
    [[nodiscard]] std::optional<std::string> unreadableFile() const;
    /// Called whenever unsavedFile() or unreadableFile() changes.
    void onUnsavedFileChanged(std::function<void()> callback) { m_noticeChanged = std::move(callback); }

private:
    struct Setting {
        std::string section;
        std::string key;
        std::string value;
    };
    struct UnsavedFile {
        std::string name;
        std::vector<Setting> settings;
        // The file's content and the same with the settings, made once: a large file is not copied for each read.
        mutable std::shared_ptr<const ProfileText> content;
        mutable std::shared_ptr<const ProfileText> changed;
    };
    using Notice = std::pair<std::optional<std::string>, std::optional<std::string>>;

    UnsavedFile& unsavedPart(std::string_view fileName);
    [[nodiscard]] bool save(const UnsavedFile& unsaved);
    [[nodiscard]] bool changeFile(const UnsavedFile& unsaved);
    [[nodiscard]] static std::shared_ptr<const ProfileText> changed(const UnsavedFile& unsaved,
                                                                    const std::shared_ptr<const ProfileText>& content);
    [[nodiscard]] std::shared_ptr<const ProfileText> load(std::string_view fileName,
                                                          const std::filesystem::path& path) const;
    [[nodiscard]] Notice notice() const { return {unsavedFile(), unreadableFile()}; }
    void tellChange(const Notice& before) const;

    std::filesystem::path m_path;
    mutable ProfileCache m_profiles;
    std::vector<UnsavedFile> m_unsaved;             // the one that failed last at the end
    mutable std::vector<std::string> m_unreadable;  // likewise
    std::function<void()> m_noticeChanged;
    bool m_readOnly = false;
};

}  // namespace kdx
