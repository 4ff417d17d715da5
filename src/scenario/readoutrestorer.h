#pragma once

#include "scenario/attendance.h"

namespace kdx {
class Instrument;
}

namespace kdx::scenario {

/// Keeps everything that can be read back of the instrument.
class ReadoutRestorer final : public Restorer {
public:
    explicit ReadoutRestorer(Instrument& instrument) : m_instrument(instrument) {}

    [[nodiscard]] bool remember() override;
    [[nodiscard]] std::optional<SettingCommands> commands() override;
    [[nodiscard]] std::optional<std::vector<std::string>> changed() override;

private:
    [[nodiscard]] std::optional<Differences> differing() const;

    Instrument& m_instrument;
    Readout m_before;
};

}  // namespace kdx::scenario
