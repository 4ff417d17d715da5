#pragma once

#include <array>
#include <cstdint>
#include <optional>
#include <string_view>
#include <vector>

#include "settings/profilelines.h"

namespace kdx {

/// Where the sections and keys of a profile file are, found in one pass over its bytes: the first section of a name
/// and the first key of a name in it count. The bytes stay with the caller, who hands in the same ones each time.
class ProfileIndex {
public:
    explicit ProfileIndex(std::string_view bytes);

    /// Adds what was put behind the bytes it was made of. @param begin their length.
    void addLines(std::string_view bytes, std::size_t begin);

    [[nodiscard]] std::optional<ProfileLine> header(std::string_view bytes, std::string_view section) const;
    [[nodiscard]] std::optional<ProfileLine> key(std::string_view bytes, std::string_view section,
                                                 std::string_view key) const;

private:
    /// A header or a key; small, since a file may have millions.
    struct Entry {
        std::uint64_t begin;    // of its line
        std::uint32_t section;  // which of the file's headers it stands under, counted from 1; 0: it is a header
        std::uint32_t number;   // a header's own
    };
    /// The entries whose names have hashes in common, in the file's order. Appending to some hundred lists is far
    /// quicker than filling a hash table whose every entry is a miss of the processor's cache.
    struct Bucket {
        std::vector<std::uint32_t> hashes;
        std::vector<Entry> entries;
    };

    void add(std::string_view name, const Entry& entry);
    [[nodiscard]] const Entry* find(std::string_view bytes, std::uint32_t section, std::string_view name) const;

    std::array<Bucket, 256> m_buckets;
    std::uint32_t m_headers = 0;  // so many so far
};

}  // namespace kdx
