#pragma once

#include <optional>
#include <string>
#include <vector>

#include "station/readout.h"

namespace kdx {

class Captions;
class DataFolder;
class Profile;
struct Station;

/// One setting as three places have it, each as the key takes it; nothing where it is not there: a data set does not
/// send it, the instrument gave no answer, nobody asked.
struct SettingSideBySide {
    std::string key;
    std::string network;  ///< PI of the other network that it belongs to; "" for the instrument's own
    std::optional<std::string> window;
    std::optional<std::string> file;
    std::optional<std::string> instrument;
    bool refused = false;  ///< the coder does not take what the window has: it stays as it is
    bool differs = false;  ///< not all of them that are known are the same

    [[nodiscard]] bool isAt(const Reading& reading) const { return reading.key == key && reading.network == network; }
};

/// What the window has, what the file of its data set has and what an instrument has, as sending the former two would
/// make it of the instrument.
struct SideBySide {
    std::vector<SettingSideBySide> settings;
    Readout window;  ///< everything, as what the window has would make it
};

/// @param entered what the window has; @param source the window's data set; @param present what was read of the
/// instrument, empty when nobody asked it.
[[nodiscard]] SideBySide sideBySide(DataFolder& data, const Captions& captions, const Profile& source,
                                    const Station& entered, const Readout& present);

/// What makes of the instrument what the window has: of these settings, as far as they differ.
[[nodiscard]] SettingCommands commandsForWindow(const std::vector<SettingSideBySide>& settings, const Readout& window,
                                                const Corrections& corrections);

/// Puts what the instrument has of these settings where the data set keeps them.
/// @returns how many of them no file keeps, or cannot keep as the instrument has them.
std::size_t takeOver(const std::vector<SettingSideBySide>& settings, Profile& into);

}  // namespace kdx
