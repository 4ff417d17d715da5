#include "settings/profileindex.h"

#include <algorithm>
#include <string>

#include "base/codepage.h"

namespace kdx {

namespace {

constexpr std::uint32_t kHeaders = 0;

/// Every byte in upper case: the letter case of names does not count.
std::array<unsigned char, 256> upperCases() {
    std::array<unsigned char, 256> table{};
    for (std::size_t byte = 0; byte < table.size(); ++byte) {
        table.at(byte) = static_cast<unsigned char>(upperCase(std::string(1, static_cast<char>(byte))).front());
    }
    return table;
}

/// The FNV-1a hash, begun with the section.
std::uint32_t hashOf(std::uint32_t section, std::string_view name) {
    static const std::array<unsigned char, 256> kUpper = upperCases();
    constexpr std::uint64_t kPrime = 0x100000001B3;
    std::uint64_t hash = (0xCBF29CE484222325 ^ section) * kPrime;
    for (const char c : name) hash = (hash ^ kUpper[static_cast<unsigned char>(c)]) * kPrime;
    return static_cast<std::uint32_t>(hash ^ (hash >> 32U));
}

}  // namespace

ProfileIndex::ProfileIndex(std::string_view bytes) {
    addLines(bytes, firstLine(bytes));
}

void ProfileIndex::addLines(std::string_view bytes, std::size_t begin) {
    ProfileLine line;
    for (ProfileLines lines(bytes, begin); lines.next(line);) {
        const std::string_view text = textOf(bytes, line);
        if (saysNothing(text)) continue;
        if (isHeader(text)) {
            add(sectionOf(text), {line.begin, kHeaders, ++m_headers});
        } else if (m_headers > 0) {
            add(keyOf(text), {line.begin, m_headers, 0});
        }
    }
}

void ProfileIndex::add(std::string_view name, const Entry& entry) {
    const std::uint32_t hash = hashOf(entry.section, name);
    Bucket& bucket = m_buckets[hash % m_buckets.size()];
    bucket.hashes.push_back(hash);
    bucket.entries.push_back(entry);
}

std::optional<ProfileLine> ProfileIndex::header(std::string_view bytes, std::string_view section) const {
    const Entry* found = find(bytes, kHeaders, section);
    return found == nullptr ? std::nullopt : std::optional(lineAt(bytes, found->begin));
}

std::optional<ProfileLine> ProfileIndex::key(std::string_view bytes, std::string_view section,
                                             std::string_view key) const {
    const Entry* headerFound = find(bytes, kHeaders, section);
    if (headerFound == nullptr) return std::nullopt;
    const Entry* found = find(bytes, headerFound->number, key);
    return found == nullptr ? std::nullopt : std::optional(lineAt(bytes, found->begin));
}

/// The first of that name. A later section of the same name is never searched: its keys have another number.
const ProfileIndex::Entry* ProfileIndex::find(std::string_view bytes, std::uint32_t section,
                                              std::string_view name) const {
    const std::uint32_t hash = hashOf(section, name);
    const Bucket& bucket = m_buckets[hash % m_buckets.size()];
    for (auto at = bucket.hashes.begin();; ++at) {
        at = std::find(at, bucket.hashes.end(), hash);
        if (at == bucket.hashes.end()) return nullptr;
        const Entry& entry = bucket.entries[static_cast<std::size_t>(at - bucket.hashes.begin())];
        const std::string_view text = textOf(bytes, lineAt(bytes, entry.begin));
        if (entry.section == section && equalNoCase(section == kHeaders ? sectionOf(text) : keyOf(text), name)) {
            return &entry;
        }
    }
}

}  // namespace kdx
