#pragma once

#include <cstdint>
#include <filesystem>
#include <functional>
#include <map>
#include <memory>
#include <optional>
#include <string>
#include <string_view>

namespace kdx {

/// Longest value a read gives: a buffer of 255 characters with its end mark.
inline constexpr std::size_t kLongestValue = 254;

class ProfileIndex;

/// A profile file's bytes and the rules by which single values are found and replaced in them, the ones of the
/// operating system's private-profile functions. All texts are 8-bit Windows-1252; the mark of a UTF-8 file is passed
/// over. The first read goes through all bytes, every further one straight to its line.
class ProfileText {
public:
    explicit ProfileText(std::string bytes = {});

    /// A copy with room for more, so that a large file is not copied again when a value is added.
    [[nodiscard]] ProfileText toBeChanged() const;

    /// Value of the first key of that name in the first section of that name; "" when missing or empty. One outer
    /// pair of equal quotes is taken off, then the value is cut at `longest` characters.
    [[nodiscard]] std::string value(std::string_view section, std::string_view key,
                                    std::size_t longest = kLongestValue) const;

    /// True when setValue() would change nothing.
    [[nodiscard]] bool holds(std::string_view section, std::string_view key, std::string_view value) const;

    /// Replaces or adds one key; every other byte stays as it is. The value is never cut. A last line without line end
    /// gets one when it is written.
    void setValue(std::string_view section, std::string_view key, std::string_view value);

    /// All keys of the first section of that name with the values that value() gives; the first key of a name wins.
    [[nodiscard]] std::map<std::string, std::string> section(std::string_view name) const;

    /// Whether a key of the first section of that name is a wanted one; asks no further then.
    [[nodiscard]] bool anyKey(std::string_view section, const std::function<bool(std::string_view key)>& wanted) const;

    [[nodiscard]] const std::string& bytes() const { return m_bytes; }

private:
    [[nodiscard]] const ProfileIndex& index() const;

    std::string m_bytes;
    mutable std::shared_ptr<const ProfileIndex> m_index;  // made at the first read
};

/// Whether the bytes begin with the mark of a UTF-16 text, in which no 8-bit key can be found or put.
[[nodiscard]] bool isUtf16(std::string_view bytes);

/// So many bytes a file of settings has at most: a larger one is garbage, and would take the machine's memory.
inline constexpr std::uintmax_t kMostBytes = std::uintmax_t{256} << 20U;

/// The file's bytes, or nothing when it is missing, cannot be read or has more than @p most bytes.
[[nodiscard]] std::optional<std::string> readFile(const std::filesystem::path& file, std::uintmax_t most = kMostBytes);

/// Whether the file can be read and has these bytes and no more; a large one is compared without being held.
[[nodiscard]] bool fileHolds(const std::filesystem::path& file, std::string_view bytes);

/// The file's bytes, to be changed and written back: "" for one yet to be made, nothing for one that is there but
/// cannot be read, as writing it would lose what is in it.
[[nodiscard]] std::optional<std::string> readToChange(const std::filesystem::path& file);

/// Replaces the file's content in one step: written beside it, flushed to disk, renamed over it; owner and mode are
/// kept, a link is followed. False on any failure, and then the file is as it was.
[[nodiscard]] bool replaceFile(const std::filesystem::path& file, std::string_view bytes);

}  // namespace kdx
