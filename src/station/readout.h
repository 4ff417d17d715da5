#pragma once

#include <optional>
#include <string>
#include <string_view>
#include <vector>

#include "settings/corrections.h"

namespace kdx {

class Instrument;

/// The key that a whole other network is known by.
inline constexpr std::string_view kNetworkKey = "EON_PI";

/// One value that the instrument was asked for. All texts are 8-bit Windows-1252.
struct Reading {
    std::string key;                   ///< of the key table; "RT_N", "FM" and "AM" are beside it
    std::string network;               ///< PI of the other network that it belongs to; "" for the instrument's own
    std::optional<std::string> value;  ///< as the key takes it; nothing when the instrument gave no answer
    bool operator==(const Reading&) const = default;
};

/// Everything that can be read back of an instrument: what it transmits, but for the clock and the groups 3A and 8A,
/// which come and go.
using Readout = std::vector<Reading>;

/// A value that two instruments have each in their own way; nothing where a whole network is not there.
struct Difference {
    std::string key;
    std::string network;
    std::optional<std::string> wanted;
    std::optional<std::string> present;
};
using Differences = std::vector<Difference>;

/// A command that sets one value.
struct SettingCommand {
    std::string key;
    std::string command;  ///< as it goes to the instrument
};
using SettingCommands = std::vector<SettingCommand>;

/// Asks for everything, as one sequence: one failure ends all of it. Questions that one instrument or another does not
/// know stay without a value, the one for the other networks under kNetworkKey.
[[nodiscard]] Readout readOut(Instrument& instrument);

/// What of it the instrument gave no answer to.
[[nodiscard]] Readout unanswered(const Readout& readout);

/// Where the present values are others than the wanted ones; numbers count by what they mean. What either side gave no
/// answer to is not compared.
[[nodiscard]] Differences differences(const Readout& wanted, const Readout& present);

/// What makes the present values the wanted ones, in the order it is to be sent. The coder cannot be without AF lists
/// again once it has one, and takes no empty group sequence: these have no command. A text with a double quote has one
/// where quotes are doubled.
[[nodiscard]] SettingCommands commandsFor(const Differences& differing, const Readout& wanted,
                                          const Corrections& corrections = {});

/// Whether sending the one key sets the value that is read back under the other.
[[nodiscard]] bool setsReading(const std::string& sent, const std::string& key);

/// What the key stands for, in words; "" for an unknown one.
[[nodiscard]] std::string meaningOf(const std::string& key);

}  // namespace kdx
