#pragma once

#include <optional>
#include <string>
#include <string_view>
#include <vector>

#include "air/group.h"
#include "air/groupwaits.h"

namespace kdx::sim {
struct Transmission;
}

namespace kdx::air {

/// What the groups of the coder's settings are spent on. The clock's group at the full minute and the bursts of 14B
/// when another network begins or ends an announcement come between: they delay what is waited for by a group each.
struct GroupBudget {
    struct Share {
        GroupType type{};
        double share = 0;  ///< of 1
    };
    /// What a radio that tunes in waits for.
    enum class What { Ps, AfLists, Radiotext, Networks, TrafficMessage, Ta };
    struct Item {
        What what{};
        bool isSet = false;        ///< the settings hold it
        std::optional<Wait> wait;  ///< nothing when it is not set, or never whole on the air
    };

    std::vector<Share> shares;  ///< in the order of the types; none while no groups go out
    std::vector<Item> items;    ///< each once, in their order
    std::vector<std::string> warnings;
};

[[nodiscard]] GroupBudget groupBudgetOf(const sim::Transmission& transmission);

/// "0A", "14B".
[[nodiscard]] std::string nameOf(GroupType type);
[[nodiscard]] std::string_view nameOf(GroupBudget::What what);

}  // namespace kdx::air
