#pragma once

#include <cstddef>
#include <initializer_list>
#include <optional>
#include <vector>

#include "air/group.h"

namespace kdx::air {

/// How long something takes a radio that tunes in, in seconds, over all moments at which it may do so. The group that
/// is under way then is lost to it.
struct Wait {
    double mean = 0;
    double worst = 0;
};

/// @param groups for a radio that hears from the beginning of the first, the second ... group of a period on: how many
/// groups it needs.
[[nodiscard]] Wait waitOver(const std::vector<std::size_t>& groups);

/// Where groups of some types go out in a ring of slots.
class Places {
public:
    Places(const std::vector<GroupType>& ring, std::initializer_list<GroupType> types);
    [[nodiscard]] bool empty() const { return m_places.empty(); }

    /// Groups from the beginning of a slot on until so many of these are over; there must be one.
    [[nodiscard]] std::size_t groupsUntil(std::size_t slot, std::size_t count) const;
    /// The wait for so many of them: what is sent in so many parts, in turn, is whole then. Nothing when there are
    /// none.
    [[nodiscard]] std::optional<Wait> waitFor(std::size_t count) const;
    /// The wait for lists of so many parts each, which are sent one after the other and then again: of a list nothing
    /// is understood before its first part, which counts the others.
    [[nodiscard]] std::optional<Wait> waitForLists(const std::vector<std::size_t>& lengths) const;

private:
    std::size_t m_ringSize;
    std::vector<std::size_t> m_places;
};

/// The wait until all segments of a radiotext came in 2A, or all in 2B; nothing when they never do. The two types share
/// one counter, so that where they are mixed each may be left with some segments only.
[[nodiscard]] std::optional<Wait> radiotextWait(const std::vector<GroupType>& ring, std::size_t segmentsOf2A,
                                                std::size_t segmentsOf2B);

}  // namespace kdx::air
