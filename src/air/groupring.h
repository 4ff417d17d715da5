#pragma once

#include <optional>
#include <string_view>
#include <vector>

#include "air/group.h"

namespace kdx::air {

/// The slots of a group sequence as they are named; nothing when it is empty or cannot be read.
[[nodiscard]] std::optional<std::vector<GroupType>> namedSlots(std::string_view sequence);

/// The slots of a group sequence ("0A,2A,8A"). A type that the coder has no data for is a slot of 0A; a sequence that
/// is empty or cannot be read means 0A,2A.
[[nodiscard]] std::vector<GroupType> groupRing(std::string_view sequence);

}  // namespace kdx::air
