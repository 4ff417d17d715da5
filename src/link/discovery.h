#pragma once

#include <chrono>
#include <cstdint>
#include <functional>
#include <string>
#include <vector>

#include "link/visa.h"

namespace kdx {

/// How instruments are looked for.
struct Discovery {
    std::chrono::milliseconds wait{1000};  ///< for answers
    std::uint16_t portMapperPort = 111;
    std::function<bool()> stopped = [] { return false; };  ///< asked a few times a second
};

/// The addresses of the VXI-11 instruments that answer in this machine's networks and on the machine itself, in dotted
/// form and in their order: everybody's port mapper is asked for the instruments' program.
[[nodiscard]] std::vector<std::string> discoverLanInstruments(const Discovery& how);

/// What an instrument says to *IDN?, without its line end; empty when it says nothing.
struct Identification {
    std::string text;
    VisaStatus status = 0;  ///< negative: why there is none
};

/// Asks the instrument who it is, in a session for this one question.
[[nodiscard]] Identification identify(Visa& visa, const std::string& resource);

}  // namespace kdx
