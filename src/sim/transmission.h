#pragma once

#include <chrono>
#include <optional>
#include <string_view>

#include "sim/setup.h"

namespace kdx::sim {

/// All that decides what the instrument transmits; it belongs to the instrument and holds until its next command.
struct Transmission {
    const InstrumentSettings& settings;
    std::string_view openData;        ///< the last value of "3A="; "" when there was none
    std::string_view trafficMessage;  ///< the last value of "8A="
    /// How far the coder's clock runs ahead of the clock that the instrument was given; nothing while it is off.
    std::optional<std::chrono::milliseconds> clockLead;
};

}  // namespace kdx::sim
