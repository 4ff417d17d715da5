#include "air/radiotext.h"

#include <algorithm>

#include "air/characters.h"
#include "base/numbers.h"
#include "sim/scpi.h"

namespace kdx::air {

namespace {

constexpr std::uint8_t kEndMark = 0x0D;
constexpr unsigned kFlagB = 0x10;

}  // namespace

void Radiotext::take(const std::string& text, std::string_view numbers, Warnings& warnings) {
    if (text == m_text) return;
    m_text = text;
    m_segment = 0;
    if (text.empty()) return;
    writeCodes(text, m_codes, "radiotext", warnings);
    m_length = text.size();
    if (m_length < m_codes.size()) m_codes.at(m_length++) = kEndMark;
    if (m_lastText.empty()) {
        m_flag = leadingNumber(sim::cutAt(numbers, ',').tail.value_or("")) != 0;
    } else if (text != m_lastText) {
        m_flag = !m_flag;
    }
    m_lastText = text;
}

std::size_t Radiotext::segments(std::size_t size) const {
    return std::min((m_length + size - 1) / size, kMostSegments);
}

Radiotext::Segment Radiotext::next(std::size_t size) {
    if (m_segment >= segments(size)) m_segment = 0;
    const std::size_t at = m_segment++;
    return {(m_flag ? kFlagB : 0) | static_cast<unsigned>(at), std::span(m_codes).subspan(at * size, size)};
}

}  // namespace kdx::air
