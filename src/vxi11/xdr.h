#pragma once

#include <cstddef>
#include <cstdint>
#include <string>
#include <string_view>

namespace kdx {

/// The 32-bit word whose four bytes stand there; they have to be there.
inline std::uint32_t xdrWord(std::string_view bytes, std::size_t at = 0) {
    std::uint32_t value = 0;
    for (const char byte : bytes.substr(at, 4)) value = value << 8U | static_cast<unsigned char>(byte);
    return value;
}

/// Writes values in the external data representation (XDR, RFC 4506): words of 32 bits, the highest byte first, and
/// bytes with their count before them, filled up to whole words.
class XdrWriter {
public:
    XdrWriter& word(std::uint32_t value);
    XdrWriter& word(std::int32_t value) { return word(static_cast<std::uint32_t>(value)); }
    XdrWriter& counted(std::string_view bytes);

    [[nodiscard]] std::string bytes() const { return m_bytes; }

private:
    std::string m_bytes;
};

/// Reads such values one after the other. What is not there reads as 0 or nothing, and so does all that follows.
class XdrReader {
public:
    /// @param bytes lent: counted() leads into them.
    explicit XdrReader(std::string_view bytes) : m_left(bytes) {}

    std::uint32_t word();
    std::int32_t signedWord() { return static_cast<std::int32_t>(word()); }
    /// Bytes with their count before them; not there when the count is greater than that.
    std::string_view counted(std::size_t atMost);

    /// What has not been read yet.
    [[nodiscard]] std::string_view rest() const { return m_left; }
    /// Whether all that was asked for was there.
    explicit operator bool() const { return m_whole; }

private:
    std::string_view take(std::size_t count);

    std::string_view m_left;
    bool m_whole = true;
};

}  // namespace kdx
