#include "groups/sequenceedit.h"

#include <algorithm>

#include "base/split.h"

namespace kdx {

std::vector<std::string> groupsOf(std::string_view sequence) {
    std::vector<std::string> groups;
    for (const std::string_view group : split(sequence, ",")) {
        if (!group.empty()) groups.emplace_back(group);
    }
    return groups;
}

std::string sequenceOf(const std::vector<std::string>& groups) {
    std::string sequence;
    for (const std::string& group : groups) sequence += group + ",";
    return sequence;
}

std::size_t moveGroup(std::vector<std::string>& groups, std::size_t at, int by) {
    const auto from = static_cast<std::ptrdiff_t>(at);
    const auto to = from + by;
    if (from >= std::ssize(groups) || to < 0 || to >= std::ssize(groups)) return at;
    std::string group = std::move(groups[at]);
    groups.erase(groups.begin() + from);
    groups.insert(groups.begin() + to, std::move(group));
    return static_cast<std::size_t>(to);
}

std::vector<std::pair<std::string, std::size_t>> groupCounts(const std::vector<std::string>& groups) {
    std::vector<std::pair<std::string, std::size_t>> counts;
    for (const std::string& group : groups) {
        const auto known =
            std::find_if(counts.begin(), counts.end(), [&group](const auto& count) { return count.first == group; });
        if (known == counts.end()) {
            counts.emplace_back(group, 1);
        } else {
            ++known->second;
        }
    }
    return counts;
}

}  // namespace kdx
