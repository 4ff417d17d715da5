#include "settings/profilecache.h"

#include <string>
#include <utility>

namespace kdx {

std::shared_ptr<const ProfileText> ProfileCache::load(const std::filesystem::path& file) {
    const std::optional<FileIdentity> identity = identityOf(file);
    Entry& entry = m_entries[file];
    if (entry.text && identity && entry.identity == identity) return entry.text;
    const bool settled = identity && isSettled(*identity);
    // The same bytes need not be searched for their lines again.
    if (!entry.text || !fileHolds(file, entry.text->bytes())) {
        std::optional<std::string> bytes = readFile(file);
        if (!bytes || isUtf16(*bytes)) {
            m_entries.erase(file);
            return nullptr;
        }
        entry.text = std::make_shared<const ProfileText>(std::move(*bytes));
    }
    entry.identity = settled && identityOf(file) == identity ? identity : std::nullopt;
    return entry.text;
}

void ProfileCache::written(const std::filesystem::path& file, std::shared_ptr<const ProfileText> text) {
    m_entries[file] = {std::nullopt, std::move(text)};
}

}  // namespace kdx
