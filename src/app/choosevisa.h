#pragma once

#include <memory>
#include <string>

#include "link/visa.h"

namespace kdx::sim {
class VirtualInstrument;
}

namespace kdx {

class Clock;
struct LanOptions;
struct Options;

/// The instrument link that was chosen, and why, in words for the user.
struct ChosenVisa {
    std::unique_ptr<sim::VirtualInstrument> simulated;  ///< the virtual instrument, when it is the one
    std::unique_ptr<Visa> visa;                         ///< null when a library that was asked for cannot be used
    std::string description;                            ///< what is used, and why not something else
    ChosenVisa();
    ~ChosenVisa();
    ChosenVisa(ChosenVisa&& other) noexcept;
    ChosenVisa& operator=(ChosenVisa&& other) noexcept;
};

/// The times of the built-in LAN client as they were asked for.
[[nodiscard]] LanOptions lanOptions(const Options& options);

/// The virtual instrument when it is asked for; else the VISA library asked for; else an installed one; else the
/// built-in LAN client.
[[nodiscard]] ChosenVisa chooseVisa(const Options& options, const Clock& clock);

}  // namespace kdx
