#pragma once

#include <string>
#include <string_view>

namespace kdx {

/// Addresses of the GPIB run from 0 to this one, primary and secondary ones.
constexpr int kHighestGpibAddress = 30;

/// How the settings and the window name the interface in use.
inline constexpr const char* kGpibInterface = "IEC";
inline constexpr const char* kLanInterface = "TCPIP";

/// Whether an interface that is named so is the LAN. A session opens on the GPIB by every other name.
[[nodiscard]] inline bool isLan(std::string_view interfaceKind) {
    return interfaceKind == kLanInterface;
}

/// A VISA resource string taken apart; the views point into it.
struct Resource {
    enum class Kind { Unknown, Lan, Gpib };
    /// Told by the first part alone: "TCPIP" or "GPIB" in any letter case, with or without a board number.
    Kind kind = Kind::Unknown;
    /// The rest is as it should be: an address, perhaps a device, "INSTR" in any letter case, none of them empty. On
    /// the GPIB both are numbers in range; what LAN addresses look like is for the network to know.
    bool wellFormed = false;
    std::string_view address;  ///< host or primary address; empty unless wellFormed
    std::string_view device;   ///< device at the host or secondary address; empty when there is none
};

/// Takes "TCPIP::host::INSTR", "TCPIP::host::device::INSTR", "GPIB0::28::INSTR" and the like apart.
[[nodiscard]] Resource parseResource(std::string_view text);

/// The resource string of an instrument. @param address host or host::device on the LAN, else a GPIB address.
[[nodiscard]] std::string resourceText(Resource::Kind kind, const std::string& address);

}  // namespace kdx
