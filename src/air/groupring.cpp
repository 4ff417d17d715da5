#include "air/groupring.h"

#include <algorithm>
#include <array>

#include "base/split.h"
#include "coder/fieldsizes.h"
#include "sim/scpi.h"

namespace kdx::air {

namespace {

constexpr std::array kTypes = {
    GroupType::Basic0A, GroupType::Basic0B,   GroupType::Radiotext2A, GroupType::Radiotext2B, GroupType::OpenData3A,
    GroupType::Clock4A, GroupType::Traffic8A, GroupType::Networks14A, GroupType::Networks14B, GroupType::Tuning15B};

std::optional<GroupType> typeOf(std::string_view slot) {
    if (slot.empty() || (slot.back() != 'A' && slot.back() != 'B')) return std::nullopt;
    const auto number = sim::readWhole(slot.substr(0, slot.size() - 1));
    if (!number || *number < 0 || *number > kHighestGroup) return std::nullopt;
    return static_cast<GroupType>(2 * *number + (slot.back() == 'B' ? 1 : 0));
}

}  // namespace

std::optional<std::vector<GroupType>> namedSlots(std::string_view sequence) {
    std::vector<GroupType> slots;
    for (const std::string_view slot : split(sequence, ",")) {
        const auto type = typeOf(slot);
        if (!type) return std::nullopt;
        slots.push_back(*type);
    }
    return slots;
}

std::vector<GroupType> groupRing(std::string_view sequence) {
    auto slots = namedSlots(sequence);
    if (!slots) return {GroupType::Basic0A, GroupType::Radiotext2A};
    std::replace_if(
        slots->begin(), slots->end(),
        [](GroupType type) { return std::find(kTypes.begin(), kTypes.end(), type) == kTypes.end(); },
        GroupType::Basic0A);
    return *std::move(slots);
}

}  // namespace kdx::air
