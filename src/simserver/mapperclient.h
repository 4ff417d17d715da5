#pragma once

#include "link/rpcchannel.h"
#include "simserver/portmapper.h"

#include <cstdint>
#include <optional>
#include <string>

namespace kdx::simserver {

/// One conversation with the port mapper that runs on this machine. Whatever the port mapper does, it is over at the
/// deadline.
class MapperClient {
public:
    /// Connects over the loopback address, from where they let others register; in vain, at the other address: one may
    /// listen there alone.
    MapperClient(const std::string& otherAddress, unsigned short mapperPort, Deadline deadline);

    [[nodiscard]] bool isConnected() const { return m_connected; }
    /// The port that is registered for the program, 0 for none; nothing when no answer came.
    std::optional<std::uint32_t> portOf(const PortMapping& mapping);
    /// False when somebody is registered already, or no answer came.
    bool add(const PortMapping& mapping);
    void remove(const PortMapping& mapping);

private:
    std::optional<std::uint32_t> ask(std::uint32_t procedure, const PortMapping& mapping);

    RpcChannel m_channel;
    Deadline m_deadline;
    bool m_connected;
};

}  // namespace kdx::simserver
