#include "vxi11/rpcrecord.h"

#include "vxi11/xdr.h"

#include <cstdint>
#include <utility>

namespace kdx {
namespace {

constexpr std::size_t kMarkSize = 4;
constexpr std::uint32_t kLastFragment = 0x80000000U;

}  // namespace

std::optional<std::string> RecordReader::next() {
    while (!m_tooLong && m_unread.size() >= kMarkSize) {
        const std::uint32_t mark = xdrWord(m_unread);
        const std::size_t length = mark & ~kLastFragment;
        if (length > m_longest - m_record.size()) {
            m_tooLong = true;
            break;
        }
        if (m_unread.size() - kMarkSize < length) break;
        m_record.append(m_unread, kMarkSize, length);
        m_unread.erase(0, kMarkSize + length);
        if ((mark & kLastFragment) != 0) return std::exchange(m_record, {});
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
