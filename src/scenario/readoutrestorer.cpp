#include "scenario/readoutrestorer.h"

#include <algorithm>

namespace kdx::scenario {

bool ReadoutRestorer::remember() {
    m_before = readOut(m_instrument);
    return std::any_of(m_before.begin(), m_before.end(),
                       [](const Reading& reading) { return reading.value.has_value(); });
}

std::optional<SettingCommands> ReadoutRestorer::commands() {
    const auto differences = differing();
    return differences ? std::optional(commandsFor(*differences, m_before, m_corrections)) : std::nullopt;
}

std::optional<std::vector<std::string>> ReadoutRestorer::changed() {
    const auto differences = differing();
    return differences ? std::optional(keysOf(*differences)) : std::nullopt;
}

/// Nothing when the instrument gave fewer answers than before.
std::optional<Differences> ReadoutRestorer::differing() const {
    const Readout present = readOut(m_instrument);
    const Readout silent = unanswered(present);
    const Readout silentBefore = unanswered(m_before);
    const bool told = std::all_of(silent.begin(), silent.end(), [&](const Reading& reading) {
        return std::find(silentBefore.begin(), silentBefore.end(), reading) != silentBefore.end();
    });
    return told ? std::optional(differences(m_before, present)) : std::nullopt;
}

}  // namespace kdx::scenario
