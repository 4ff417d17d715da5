#include "settings/datafolder.h"

#include <algorithm>
#include <system_error>
#include <utility>

#include "base/codepage.h"
#include "settings/profilefile.h"
#include "settings/shownpath.h"

namespace kdx {

namespace {

namespace fs = std::filesystem;

bool isThere(const fs::path& path) {
    std::error_code error;
    return fs::exists(fs::symlink_status(path, error));  // a link counts even when it leads nowhere
}

/// The folder's entry of that name in any letter case, the exactly spelled one first, else the first by the alphabet;
/// without one the path at which it would be created.
fs::path entryNamed(const fs::path& folder, const fs::path& name) {
    fs::path exact = folder / name;
    if (isThere(exact)) return exact;
    fs::path found;
    const std::string wanted = shownPath(name);
    std::error_code error;
    for (fs::directory_iterator entry(folder, error), end; !error && entry != end; entry.increment(error)) {
        const fs::path& path = entry->path();
        if (equalNoCase(shownPath(path.filename()), wanted) && (found.empty() || path < found)) found = path;
    }
    return found.empty() ? exact : found;
}

}  // namespace

std::string dataSetFile(std::string_view number) {
    return std::string("Datenset").append(number).append(".INI");
}

DataFolder::DataFolder(const fs::path& appFolder) : m_path(entryNamed(appFolder, "Daten")) {}

fs::path DataFolder::file(const fs::path& name) const {
    return entryNamed(m_path, name);
}

std::string DataFolder::ReadIni(std::string_view section, std::string_view key, std::string_view fileName) const {
    const auto text = profile(fileName);
    return text ? text->value(section, key) : std::string();
}

std::shared_ptr<const ProfileText> DataFolder::profile(std::string_view fileName) const {
    return m_profiles.load(file(fileName));
}

void DataFolder::WriteIni(std::string_view section, std::string_view key, std::string_view value,
                          std::string_view fileName) {
    const fs::path path = file(fileName);
    const auto before = m_profiles.load(path);
    if (before && before->holds(section, key, value)) return;  // spare the disk
    std::error_code error;
    if (!before && fs::status(path, error).type() != fs::file_type::not_found) {
        noteSaved(fileName, false);  // there but not readable: writing would lose what is in it
        return;
    }
    ProfileText text = before ? *before : ProfileText();
    text.setValue(section, key, value);
    noteSaved(fileName, replaceFile(path, text.bytes()));
}

std::optional<std::string> DataFolder::unsavedFile() const {
    return m_unsavedFiles.empty() ? std::nullopt : std::optional(m_unsavedFiles.back());
}

void DataFolder::noteSaved(std::string_view fileName, bool saved) {
    const std::optional<std::string> before = unsavedFile();
    std::erase_if(m_unsavedFiles, [&](const std::string& name) { return equalNoCase(name, fileName); });
    if (!saved) m_unsavedFiles.emplace_back(fileName);
    if (unsavedFile() != before && m_unsavedFileChanged) m_unsavedFileChanged();
}

}  // namespace kdx
