#pragma once

#include <functional>
#include <string>

#include "air/receivertraffic.h"

namespace kdx::air {

/// Where the texts of events and locations are looked up (UTF-8); one that is not known is empty, and so may be the
/// look-up itself.
struct TrafficTexts {
    std::function<std::string(unsigned number)> event;
    std::function<std::string(unsigned number)> location;
};

/// "event 1 Traffic problem, location 101 Land Probia, extent 2, direction forward ..."
[[nodiscard]] std::string inWords(const TrafficMessage& message, const TrafficTexts& texts);

/// What the group 8A is and what it says by itself.
[[nodiscard]] std::string inWords(const TrafficGroup& group, const TrafficTexts& texts);

/// What the group 3A announces, with the system information when it is the traffic message channel.
[[nodiscard]] std::string inWords(const OpenDataAnnouncement& announcement);

/// "87.6 MHz", or "153 kHz" of long and medium wave.
[[nodiscard]] std::string frequencyInWords(int kilohertz);

}  // namespace kdx::air
