#include "settings/datafolder.h"

#include <algorithm>
#include <system_error>
#include <utility>

#include "base/codepage.h"
#include "base/paths.h"
#include "settings/folderlock.h"
#include "settings/profilefile.h"
#include "settings/shownpath.h"

namespace kdx {

namespace {

namespace fs = std::filesystem;

bool isThere(const fs::path& path) {
    std::error_code error;
    return fs::exists(fs::symlink_status(path, error));  // a link counts even when it leads nowhere
}

/// Something is there, or nobody may look whether it is.
bool isTaken(const fs::path& path) {
    std::error_code error;
    return fs::status(path, error).type() != fs::file_type::not_found;
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

fs::path DataFolder::file(std::string_view name) const {
    return entryNamed(m_path, pathFromUtf8(name));
}

std::string DataFolder::ReadIni(std::string_view section, std::string_view key, std::string_view fileName) const {
    const auto text = profile(fileName);
    return text ? text->value(section, key) : std::string();
}

std::shared_ptr<const ProfileText> DataFolder::profile(std::string_view fileName) const {
    const Notice before = notice();
    const fs::path path = file(fileName);
    std::shared_ptr<const ProfileText> text = load(fileName, path);
    tellChange(before);
    const auto unsaved = std::find_if(m_unsaved.begin(), m_unsaved.end(),
                                      [&](const UnsavedFile& part) { return equalNoCase(part.name, fileName); });
    if (unsaved == m_unsaved.end()) return text;
    std::error_code error;
    const fs::file_status status = fs::status(path, error);
    // Users expect to read what they wrote, but with a folder in the file's place the operating system was seen to give
    // nothing even then, and so do we; the value is not lost, it goes out once the folder is gone.
    if (fs::exists(status) && !fs::is_regular_file(status)) return nullptr;
    return changed(*unsaved, text);
}

void DataFolder::WriteIni(std::string_view section, std::string_view key, std::string_view value,
                          std::string_view fileName) {
    const Notice before = notice();
    UnsavedFile& unsaved = unsavedPart(fileName);
    const auto same = std::find_if(unsaved.settings.begin(), unsaved.settings.end(), [&](const Setting& setting) {
        return equalNoCase(setting.section, section) && equalNoCase(setting.key, key);
    });
    if (same == unsaved.settings.end()) {
        unsaved.settings.push_back({std::string(section), std::string(key), std::string(value)});
    } else {
        same->value = value;
    }
    unsaved.changed.reset();
    if (save(unsaved)) m_unsaved.pop_back();
    tellChange(before);
}

void DataFolder::retryUnsaved() {
    const Notice before = notice();
    for (const std::string& name : std::vector(m_unreadable)) (void)load(name, file(name));
    std::erase_if(m_unsaved, [this](const UnsavedFile& unsaved) { return save(unsaved); });
    tellChange(before);
}

/// The file's part of what is not saved, moved to the end; an empty one when all of it was.
DataFolder::UnsavedFile& DataFolder::unsavedPart(std::string_view fileName) {
    const auto found = std::find_if(m_unsaved.begin(), m_unsaved.end(),
                                    [&](const UnsavedFile& part) { return equalNoCase(part.name, fileName); });
    if (found == m_unsaved.end()) return m_unsaved.emplace_back(UnsavedFile{std::string(fileName), {}, {}, {}});
    std::rotate(found, found + 1, m_unsaved.end());
    m_unsaved.back().name = fileName;
    return m_unsaved.back();
}

bool DataFolder::save(const UnsavedFile& unsaved) {
    if (m_readOnly) return false;
    bool saved = false;
    // Reading, changing and writing are one step: another program on the same folder would lose what comes between.
    return underFolderLock(m_path, [&] { saved = changeFile(unsaved); }) && saved;
}

bool DataFolder::mayWrite(const fs::path& file) const {
    if (!m_readOnly) return true;
    std::error_code error;
    const fs::path folder = fs::weakly_canonical(m_path, error);
    const fs::path target = fs::weakly_canonical(file, error);
    return !error && std::mismatch(folder.begin(), folder.end(), target.begin(), target.end()).first != folder.end();
}

bool DataFolder::changeFile(const UnsavedFile& unsaved) {
    const fs::path path = file(unsaved.name);
    const auto before = load(unsaved.name, path);
    if (!before && isTaken(path)) return false;  // there but not readable: writing would lose what is in it
    const auto isHeld = [&](const Setting& setting) {
        return before && before->holds(setting.section, setting.key, setting.value);
    };
    if (std::all_of(unsaved.settings.begin(), unsaved.settings.end(), isHeld)) return true;  // spare the disk
    const auto after = changed(unsaved, before);
    if (!replaceFile(path, after->bytes())) return false;
    m_profiles.written(path, after);
    return true;
}

/// The content with the settings that it lacks; content may be none.
std::shared_ptr<const ProfileText> DataFolder::changed(const UnsavedFile& unsaved,
                                                       const std::shared_ptr<const ProfileText>& content) {
    if (!unsaved.changed || unsaved.content != content) {
        auto text = std::make_shared<ProfileText>(content ? content->toBeChanged() : ProfileText());
        for (const Setting& setting : unsaved.settings) text->setValue(setting.section, setting.key, setting.value);
        unsaved.content = content;
        unsaved.changed = std::move(text);
    }
    return unsaved.changed;
}

std::optional<std::string> DataFolder::unsavedFile() const {
    return m_unsaved.empty() ? std::nullopt : std::optional(m_unsaved.back().name);
}

std::optional<std::string> DataFolder::unreadableFile() const {
    const auto unsaved = unsavedFile();
    const auto found = std::find_if(m_unreadable.rbegin(), m_unreadable.rend(),
                                    [&](const std::string& name) { return !unsaved || !equalNoCase(name, *unsaved); });
    return found == m_unreadable.rend() ? std::nullopt : std::optional(*found);
}

/// The file's content on disk; notes whether there is one that cannot be read.
std::shared_ptr<const ProfileText> DataFolder::load(std::string_view fileName, const fs::path& path) const {
    auto text = m_profiles.load(path);
    const bool unreadable = !text && isTaken(path);
    const auto noted = std::find_if(m_unreadable.begin(), m_unreadable.end(),
                                    [&](const std::string& name) { return equalNoCase(name, fileName); });
    if (unreadable && noted == m_unreadable.end()) {
        m_unreadable.emplace_back(fileName);
    } else if (!unreadable && noted != m_unreadable.end()) {
        m_unreadable.erase(noted);
    }
    return text;
}

void DataFolder::tellChange(const Notice& before) const {
    if (notice() != before && m_noticeChanged) m_noticeChanged();
}

}  // namespace kdx
