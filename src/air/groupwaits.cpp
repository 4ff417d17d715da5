#include "air/groupwaits.h"

#include <algorithm>
#include <array>
#include <chrono>
#include <limits>
#include <numeric>

#include "air/radiotext.h"

namespace kdx::air {

namespace {

constexpr double kGroupSeconds = std::chrono::duration<double>(kGroupTime).count();
constexpr std::size_t kNever = std::numeric_limits<std::size_t>::max();

/// What a group carries: no segment, or one of 2A, or, behind those, one of 2B.
using Carried = std::optional<std::size_t>;

/// What the groups carry while the ring goes round until it is at the same segment once more.
std::vector<Carried> periodOf(const std::vector<GroupType>& ring, std::size_t segmentsOf2A, std::size_t segmentsOf2B) {
    std::vector<Carried> groups;
    std::array<std::optional<std::size_t>, kMostSegments + 1> began;  // the group at which the ring was at the segment
    std::size_t segment = 0;
    while (!began.at(segment)) {
        began.at(segment) = groups.size();
        for (const GroupType type : ring) {
            groups.emplace_back();
            if (type != GroupType::Radiotext2A && type != GroupType::Radiotext2B) continue;
            const bool is2A = type == GroupType::Radiotext2A;
            if (segment >= (is2A ? segmentsOf2A : segmentsOf2B)) segment = 0;
            groups.back() = (is2A ? 0 : kMostSegments) + segment++;
        }
    }
    groups.erase(groups.begin(), groups.begin() + static_cast<std::ptrdiff_t>(*began.at(segment)));
    return groups;
}

}  // namespace

Wait waitOver(const std::vector<std::size_t>& groups) {
    // Of the group under way at first all may be left, or nothing, and half of it on the average.
    const auto count = static_cast<double>(groups.size());
    const auto sum = static_cast<double>(std::accumulate(groups.begin(), groups.end(), std::size_t{0}));
    const auto most = static_cast<double>(*std::max_element(groups.begin(), groups.end()));
    return {(sum / count + 0.5) * kGroupSeconds, (most + 1) * kGroupSeconds};
}

Places::Places(const std::vector<GroupType>& ring, std::initializer_list<GroupType> types) : m_ringSize(ring.size()) {
    for (std::size_t slot = 0; slot < ring.size(); ++slot) {
        if (std::find(types.begin(), types.end(), ring[slot]) != types.end()) m_places.push_back(slot);
    }
}

std::size_t Places::groupsUntil(std::size_t slot, std::size_t count) const {
    const auto first = std::lower_bound(m_places.begin(), m_places.end(), slot);
    const std::size_t last = static_cast<std::size_t>(first - m_places.begin()) + count - 1;
    return last / m_places.size() * m_ringSize + m_places[last % m_places.size()] + 1 - slot;
}

std::optional<Wait> Places::waitFor(std::size_t count) const {
    if (empty()) return std::nullopt;
    std::vector<std::size_t> groups;
    for (std::size_t slot = 0; slot < m_ringSize; ++slot) groups.push_back(groupsUntil(slot, count));
    return waitOver(groups);
}

std::optional<Wait> Places::waitForLists(const std::vector<std::size_t>& lengths) const {
    const std::size_t parts = std::accumulate(lengths.begin(), lengths.end(), std::size_t{0});
    if (empty() || parts == 0) return std::nullopt;
    std::vector<std::size_t> needed;  // parts that a radio needs which hears from this one on
    for (std::size_t part = 0; part < parts; ++part) {
        std::size_t begin = 0;
        std::size_t most = 0;
        for (const std::size_t length : lengths) {
            most = std::max(most, (begin + parts - part) % parts + length);
            begin += length;
        }
        needed.push_back(most);
    }
    // The ring begins with another part each time it comes round, until it begins with the first one again.
    std::vector<std::size_t> groups;
    std::size_t part = 0;
    do {
        std::size_t next = part;
        for (std::size_t slot = 0; slot < m_ringSize; ++slot) {
            groups.push_back(groupsUntil(slot, needed[next]));
            if (std::binary_search(m_places.begin(), m_places.end(), slot)) next = (next + 1) % parts;
        }
        part = next;
    } while (part != 0);
    return waitOver(groups);
}

std::optional<Wait> radiotextWait(const std::vector<GroupType>& ring, std::size_t segmentsOf2A,
                                  std::size_t segmentsOf2B) {
    const std::vector<Carried> period = periodOf(ring, segmentsOf2A, segmentsOf2B);
    std::array<std::size_t, 2 * kMostSegments> ends{};  // of the next group that carries it, seen from a group
    ends.fill(kNever);
    const auto begin2B = ends.begin() + kMostSegments;
    std::vector<std::size_t> groups;
    // From the end of a second period backwards, so that in the first one all that ever comes is known.
    for (std::size_t group = 2 * period.size(); group-- > 0;) {
        if (const Carried& carried = period[group % period.size()]) ends.at(*carried) = group + 1;
        if (group >= period.size()) continue;
        const std::size_t end = std::min(*std::max_element(ends.begin(), ends.begin() + segmentsOf2A),
                                         *std::max_element(begin2B, begin2B + segmentsOf2B));
        if (end == kNever) return std::nullopt;
        groups.push_back(end - group);
    }
    return waitOver(groups);
}

}  // namespace kdx::air
