#pragma once

#include <algorithm>

#include "scenario/attendance.h"

namespace kdx {
class Instrument;
}

namespace kdx::scenario {

/// Keeps everything that can be read back of the instrument.
class ReadoutRestorer final : public Restorer {
public:
    explicit ReadoutRestorer(Instrument& instrument, const Corrections& corrections = {})
        : m_instrument(instrument), m_corrections(corrections) {}

    [[nodiscard]] bool remember() override;
    [[nodiscard]] std::vector<std::string> untold() const override { return keysOf(unanswered(m_before)); }
    [[nodiscard]] std::optional<SettingCommands> commands() override;
    [[nodiscard]] std::optional<std::vector<std::string>> changed() override;

private:
    [[nodiscard]] std::optional<Differences> differing() const;
    /// Each key once.
    static std::vector<std::string> keysOf(const auto& entries) {
        std::vector<std::string> keys;
        for (const auto& entry : entries) {
            if (std::find(keys.begin(), keys.end(), entry.key) == keys.end()) keys.push_back(entry.key);
        }
        return keys;
    }

    Instrument& m_instrument;
    Corrections m_corrections;
    Readout m_before;
};

}  // namespace kdx::scenario
