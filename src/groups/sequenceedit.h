#pragma once

#include <cstddef>
#include <string>
#include <string_view>
#include <utility>
#include <vector>

namespace kdx {

// Changes of a group sequence that is being composed; its groups are each followed by a comma.

/// The groups one by one.
[[nodiscard]] std::vector<std::string> groupsOf(std::string_view sequence);

/// The sequence of the groups.
[[nodiscard]] std::string sequenceOf(const std::vector<std::string>& groups);

/// Moves a group by so many places; where there is no such place nothing changes. @returns where it stands then.
std::size_t moveGroup(std::vector<std::string>& groups, std::size_t at, int by);

/// How often each group comes, in the order of their first places.
[[nodiscard]] std::vector<std::pair<std::string, std::size_t>> groupCounts(const std::vector<std::string>& groups);

}  // namespace kdx
