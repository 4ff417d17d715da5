#pragma once

#include <filesystem>
#include <map>
#include <memory>
#include <optional>

#include "settings/durablefile.h"
#include "settings/profilefile.h"

namespace kdx {

/// Profile files as last read. A file is read again as soon as anything may have changed in it, by whomever.
class ProfileCache {
public:
    /// The file's present content; nothing when it is missing, cannot be read or is UTF-16 text.
    [[nodiscard]] std::shared_ptr<const ProfileText> load(const std::filesystem::path& file);

    /// Keeps what the file was just replaced with: as long as it is read so, it need not be searched anew.
    void written(const std::filesystem::path& file, std::shared_ptr<const ProfileText> text);

private:
    struct Entry {
        std::optional<FileIdentity> identity;  // nothing: the file may have changed without showing it
        std::shared_ptr<const ProfileText> text;
    };
    std::map<std::filesystem::path, Entry> m_entries;
};

}  // namespace kdx
