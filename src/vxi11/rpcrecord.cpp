#include "vxi11/rpcrecord.h"

#include "vxi11/xdr.h"

#include <cstdint>
#include <utility>

namespace kdx {
namespace {

constexpr std::size_t kMarkSize = 4;
constexpr std::uint32_t kLastFragment = 0x80000000U;

}  // namespace

// What is left is never more than came with the last bytes, so that no byte is moved twice.
void RecordReader::feed(std::string_view bytes) {
    m_unread.erase(0, std::exchange(m_taken, 0));
    m_unread.append(bytes);
}

std::optional<std::string> RecordReader::next() {
    while (!m_broken && m_unread.size() - m_taken >= kMarkSize) {
        const std::uint32_t mark = xdrWord(m_unread, m_taken);
        const std::size_t length = mark & ~kLastFragment;
        const bool last = (mark & kLastFragment) != 0;
        if (length > m_longest - m_record.size() || (length == 0 && !last)) {
            m_broken = true;
            break;
        }
        if (m_unread.size() - m_taken - kMarkSize < length) break;
        m_record.append(m_unread, m_taken + kMarkSize, length);
        m_taken += kMarkSize + length;
        if (last) return std::exchange(m_record, {});
    }
    return std::nullopt;
}

std::string framed(std::string_view record) {
    const std::uint32_t mark = kLastFragment | static_cast<std::uint32_t>(record.size());
    std::string result;
    for (unsigned shift = 32; shift > 0; shift -= 8) result += static_cast<char>(mark >> (shift - 8));
    return result.append(record);
}

}  // namespace kdx
