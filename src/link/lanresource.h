#pragma once

#include "link/visa.h"

#include <string>
#include <string_view>
#include <variant>

namespace kdx {

/// Where a LAN resource string leads.
struct LanResource {
    std::string host;              ///< address or name, exactly as it stands in the string
    std::string device = "inst0";  ///< the device behind that address: "inst0", "gpib0,28"
};

/// Takes "TCPIP::host::INSTR" or "TCPIP::host::device::INSTR" apart; TCPIP may carry a board number (which a computer
/// with one network does not need) and the keywords may stand in any letter case.
/// Gives the parts; kLibraryNotFound for a GPIB resource, which only an installed library can serve; else
/// kInvalidResourceName.
std::variant<LanResource, VisaStatus> parseLanResource(std::string_view resource);

}  // namespace kdx
