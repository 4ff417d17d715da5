#include "air/receiverfrequencies.h"

#include <algorithm>
#include <array>
#include <utility>

namespace kdx::air {

namespace {

// Codes that are no frequency (IEC 62106, 6.2.1.6.1, table 11).
constexpr unsigned kFirstCount = 224;
constexpr unsigned kLastCount = 249;
constexpr unsigned kAmFollows = 250;

/// In method B every pair behind the tuned frequency has that in it (6.2.1.6.4).
bool isMethodB(const std::vector<int>& codes) {
    if (codes.size() < 3 || codes.size() % 2 == 0) return false;
    for (std::size_t at = 1; at < codes.size(); at += 2) {
        if (codes[at] != codes[0] && codes[at + 1] != codes[0]) return false;
    }
    return true;
}

FrequencyList listOf(const std::vector<int>& codes) {
    FrequencyList list;
    list.methodB = isMethodB(codes);
    if (!list.methodB) {
        for (const int kilohertz : codes) list.alternatives.push_back({kilohertz, false});
        return list;
    }
    list.tuned = codes[0];
    for (std::size_t at = 1; at < codes.size(); at += 2) {
        // A pair that rises carries the same programme, one that falls a regional variant of it.
        const int other = codes[at] == list.tuned ? codes[at + 1] : codes[at];
        list.alternatives.push_back({other, codes[at] > codes[at + 1]});
    }
    return list;
}

}  // namespace

int vhfKilohertz(unsigned code) {
    constexpr unsigned kHighest = 204;
    return code >= 1 && code <= kHighest ? 87500 + 100 * static_cast<int>(code) : 0;
}

int amKilohertz(unsigned code) {
    constexpr unsigned kLongWave = 15;
    constexpr unsigned kMediumWave = 135;
    const int number = static_cast<int>(code);
    if (code >= 1 && code <= kLongWave) return 144 + 9 * number;
    return code > kLongWave && code <= kMediumWave ? 531 + 9 * (number - 16) : 0;
}

void FrequencyLists::take(std::optional<std::uint16_t> pair) {
    if (!pair) {
        breakOff();
        return;
    }
    const unsigned codes = *pair;
    for (const unsigned code : std::array{codes >> 8U, codes & 0xFFU}) {
        if (code >= kFirstCount && code <= kLastCount) {
            begin(code - kFirstCount);
        } else if (m_awaited > 0) {
            takeCode(code);
        }
    }
}

void FrequencyLists::begin(unsigned count) {
    breakOff();
    m_codes.clear();
    m_awaited = count;
    ++m_count;
    if (count > 0) return;
    m_heard.clear();
    m_latest = {};
}

/// A list that was not heard to its end is still on the air: it must not be taken for gone.
void FrequencyLists::breakOff() {
    if (m_awaited > 0 && !m_codes.empty()) {
        for (Heard& heard : m_heard) {
            if (heard.count == m_awaited && heard.first == m_codes.front()) hearAgain(heard);
        }
    }
    m_awaited = 0;
    m_amFollows = false;
}

void FrequencyLists::hearAgain(Heard& heard) const {
    heard.turns = {m_count, heard.turns[0], heard.turns[1]};
}

void FrequencyLists::takeCode(unsigned code) {
    if (!m_amFollows && code == kAmFollows) {
        m_amFollows = true;
        return;
    }
    const int kilohertz = std::exchange(m_amFollows, false) ? amKilohertz(code) : vhfKilohertz(code);
    if (kilohertz != 0) m_codes.push_back(kilohertz);
    if (m_codes.size() < m_awaited) return;
    m_awaited = 0;
    endOfList();
}

void FrequencyLists::endOfList() {
    m_latest = listOf(m_codes);
    const auto isLatest = [this](const Heard& heard) { return heard.list == m_latest; };
    const auto known = std::find_if(m_heard.begin(), m_heard.end(), isLatest);
    if (known == m_heard.end()) {
        m_heard.push_back({m_latest, m_codes.size(), m_codes.front(), {m_count, 0, 0}});
        return;
    }
    // All lists come in turn: one that three turns of this one went without is no longer sent.
    const std::uint64_t oldest = known->turns.back();
    hearAgain(*known);
    const auto isGone = [oldest](const Heard& heard) { return heard.turns.front() < oldest; };
    m_heard.erase(std::remove_if(m_heard.begin(), m_heard.end(), isGone), m_heard.end());
}

std::vector<FrequencyList> FrequencyLists::lists() const {
    std::vector<FrequencyList> lists;
    for (const Heard& heard : m_heard) lists.push_back(heard.list);
    return lists;
}

}  // namespace kdx::air
