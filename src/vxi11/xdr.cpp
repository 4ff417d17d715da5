#include "vxi11/xdr.h"

namespace kdx {

namespace {

constexpr std::size_t kWord = 4;

/// How many bytes are missing to whole words.
std::size_t filling(std::size_t count) {
    return (kWord - count % kWord) % kWord;
}

}  // namespace

XdrWriter& XdrWriter::word(std::uint32_t value) {
    for (unsigned shift = 32; shift > 0; shift -= 8) m_bytes += static_cast<char>(value >> (shift - 8));
    return *this;
}

XdrWriter& XdrWriter::counted(std::string_view bytes) {
    word(static_cast<std::uint32_t>(bytes.size()));
    m_bytes.append(bytes).append(filling(bytes.size()), '\0');
    return *this;
}

std::string_view XdrReader::take(std::size_t count) {
    m_whole = m_whole && count <= m_left.size();
    if (!m_whole) return {};
    const std::string_view taken = m_left.substr(0, count);
    m_left.remove_prefix(count);
    return taken;
}

std::uint32_t XdrReader::word() {
    return xdrWord(take(kWord));
}

std::string_view XdrReader::counted(std::size_t atMost) {
    const std::size_t count = word();
    if (count > atMost) m_whole = false;
    const std::string_view bytes = take(count);
    take(m_whole ? filling(count) : 0);
    return m_whole ? bytes : std::string_view();
}

}  // namespace kdx
