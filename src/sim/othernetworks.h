#pragma once

#include <optional>
#include <string>
#include <string_view>
#include <vector>

#include "coder/fieldsizes.h"
#include "sim/aflists.h"
#include "sim/errorqueue.h"

namespace kdx::sim {

/// One other programme that the coder announces.
struct OtherNetwork {
    std::string pi;  ///< four hexadecimal digits, in capitals
    std::string ps = std::string(kPsLength, ' ');
    int pty = 0;
    bool tp = false;
    bool ta = false;
    std::string methodA;  ///< its AF list for method A, as sent
    AfLists lists;
};

/// The coder's enhanced-other-networks entries and the commands and queries that belong to them.
class OtherNetworks {
public:
    /// So many identifications fit into one answer of 60 bytes, which is what the program reads at a time.
    static constexpr std::size_t kCapacity = 11;

    /// True for a command or query of this table ("EON-PI", "EON-PS", "EON-AFB", "EON-DEL" ...), in capitals.
    [[nodiscard]] static bool knows(std::string_view name);

    /// @param name as above; @param value the PI alone ("EON-PI", "EON-DEL") or the PI, a comma and the value.
    ScpiError command(std::string_view name, std::string_view value);

    /// @param argument nothing for "EON-PI" (all networks); the PI for the others, with ",1" to ",5" for "EON-AFB". A
    /// network the coder does not hold is an error and gives an empty answer too, so that nobody waits in vain.
    [[nodiscard]] Reply query(std::string_view name, std::optional<std::string_view> argument) const;

    [[nodiscard]] const std::vector<OtherNetwork>& networks() const { return m_networks; }

private:
    ScpiError add(std::string_view pi);
    ScpiError remove(std::string_view pi);
    [[nodiscard]] std::string identifications() const;
    [[nodiscard]] const OtherNetwork* find(std::string_view pi) const;

    std::vector<OtherNetwork> m_networks;
};

}  // namespace kdx::sim
