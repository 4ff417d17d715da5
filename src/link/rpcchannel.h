#pragma once

#include "link/deadline.h"
#include "link/rpcmessage.h"
#include "link/socket.h"
#include "vxi11/rpcrecord.h"

#include <cstdint>
#include <string>
#include <string_view>

namespace kdx {

/// Remote procedure calls (ONC RPC version 2) over one TCP connection: one program, one call at a time.
/// A call ends at its deadline, whatever the peer does.
class RpcChannel {
public:
    /// @param aborting set by another thread it ends a wait like a deadline that is reached; lent.
    RpcChannel(std::uint32_t program, std::uint32_t version, const std::atomic_bool& aborting = kNeverAborted)
        : m_program(program), m_version(version), m_aborting(aborting) {}

    /// Connects to the port of that address. False when nobody takes the connection until the deadline.
    bool connect(Ipv4Address address, std::uint16_t port, Deadline deadline);

    /// Calls one procedure. @param arguments in XDR
    /// After Lost, Failed, or a request that could not be sent whole, the connection is closed and every later call is
    /// Lost; after any other TimedOut it goes on, and the late answer is passed over.
    RpcOutcome call(std::uint32_t procedure, std::string_view arguments, const RpcResults& results, Deadline deadline);

private:
    static constexpr std::size_t kLargestReply = std::size_t{128} * 1024;  // twice the most that is ever asked for

    [[nodiscard]] bool waitFor(const Socket& socket, Socket::Ready ready, Deadline deadline) const;
    RpcOutcome send(Deadline deadline);
    RpcOutcome receiveReply(Deadline deadline);
    RpcOutcome close(RpcOutcome because);

    std::uint32_t m_program;
    std::uint32_t m_version;
    const std::atomic_bool& m_aborting;
    Socket m_socket;
    std::uint32_t m_lastCall = 0;  ///< number of the call under way; answers bear it
    std::string m_request;         ///< with its record mark
    RecordReader m_received{kLargestReply};
    std::string m_reply;  ///< one whole message, without record marks
};

}  // namespace kdx
