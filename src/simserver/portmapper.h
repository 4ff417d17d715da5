#pragma once

#include "simserver/pollloop.h"
#include "simserver/rpcprogram.h"
#include "simserver/rpctcpserver.h"

#include <cstdint>
#include <string>
#include <vector>

namespace kdx::simserver {

/// The port of port mappers.
constexpr unsigned short kPortMapperPort = 111;

/// Where an RPC program is to be found on this machine, over TCP.
struct PortMapping {
    std::uint32_t program = 0;
    std::uint32_t version = 0;
    unsigned short port = 0;
};

/// A port mapper (version 2 of the protocol) over TCP and UDP that knows the given programs and itself; it also answers
/// what is asked of everybody in its address's network. Others cannot register with it: its SET and UNSET answer "no".
/// Versions 3 and 4 are refused, on which clients go back to 2.
class PortMapper final : public RpcProgram {
public:
    /// Listens at once, answers while the loop runs. Throws std::system_error when it cannot have both ports.
    /// @param port for both protocols; 0: any port that is free for both.
    PortMapper(PollLoop& loop, std::vector<PortMapping> mappings, const std::string& address,
               unsigned short port = kPortMapperPort);
    ~PortMapper() override;

    [[nodiscard]] unsigned short port() const { return m_tcp.port(); }

protected:
    void call(std::uint32_t procedure, std::string_view arguments, ConnectionId from, const RpcReply& reply) override;

private:
    PortMapper(PollLoop& loop, std::vector<PortMapping> mappings, const std::string& address,
               std::pair<FileDescriptor, FileDescriptor> sockets);
    void listenForBroadcasts(const std::string& address);
    void answerDatagram(int socket, unsigned onlyInterface);
    [[nodiscard]] unsigned long findPort(unsigned long program, unsigned long protocol) const;
    [[nodiscard]] std::string dump() const;

    PollLoop& m_loop;
    std::vector<PortMapping> m_mappings;
    RpcTcpServer m_tcp;
    FileDescriptor m_udp;
    std::vector<FileDescriptor> m_broadcasts;
};

}  // namespace kdx::simserver
