#pragma once

#include "simserver/pollloop.h"
#include "simserver/rpcprogram.h"
#include "simserver/socket.h"
#include "vxi11/rpcrecord.h"

#include <chrono>
#include <cstddef>
#include <cstdint>
#include <functional>
#include <map>
#include <string>

namespace kdx::simserver {

/// How long a client of a server may keep silent.
struct SilenceLimits {
    /// A connection that nothing moves on for so long is closed: a call is not sent to its end, a reply not
    /// fetched, or none comes and the program keeps nothing for the client.
    std::chrono::milliseconds patience = std::chrono::minutes(1);
    /// The same where the program keeps something for the client.
    std::chrono::milliseconds longestSilence = std::chrono::hours(12);
    std::function<PollLoop::TimePoint()> now = std::chrono::steady_clock::now;
};

/// Serves an RPC program on a TCP port to any number of clients at once; none of them can hold up another. When memory
/// runs out over a call, its connection is closed and the others go on.
class RpcTcpServer {
public:
    /// Longest call that is taken; a client that announces a longer one is cut off.
    static constexpr std::size_t kLongestRecord = std::size_t{1024} * 1024;
    /// More clients than this wait until one has gone.
    static constexpr std::size_t kMostConnections = 128;
    /// Of one address no more are taken, so that others find room.
    static constexpr std::size_t kMostOfOnePeer = 96;

    /// Listens at once; calls are served while the loop runs. Loop and program must outlive this.
    /// @param address IPv4 address in dotted form; port 0 takes any free one. Throws std::system_error.
    RpcTcpServer(PollLoop& loop, RpcProgram& program, const std::string& address, unsigned short port,
                 SilenceLimits limits = {});
    /// The same on a socket that listens already.
    RpcTcpServer(PollLoop& loop, RpcProgram& program, FileDescriptor listener, SilenceLimits limits = {});
    RpcTcpServer(const RpcTcpServer&) = delete;
    RpcTcpServer& operator=(const RpcTcpServer&) = delete;
    ~RpcTcpServer();

    [[nodiscard]] unsigned short port() const { return localPort(m_listener); }

private:
    struct Connection {
        FileDescriptor socket;
        RecordReader reader{kLongestRecord};
        std::string unsent;
        bool inputEnded = false;
        PollLoop::TimePoint movedOn;
    };
    void acceptClient();
    void restFromAccepting();
    [[nodiscard]] std::size_t connectionsOf(std::uint32_t peer) const;
    void closeStuck();
    void serve(ConnectionId id, short events);
    void serveEvents(ConnectionId id, short events);
    void readCalls(ConnectionId id, Connection& connection);
    void endInput(ConnectionId id, Connection& connection);
    void sendRecord(ConnectionId id, const std::string& record);
    bool sendUnsent(Connection& connection) const;
    void updateEvents(const Connection& connection);
    void close(ConnectionId id);

    PollLoop& m_loop;
    RpcProgram& m_program;
    FileDescriptor m_listener;
    std::map<ConnectionId, Connection> m_connections;
    std::uint32_t m_lastSerial = 0;
    SilenceLimits m_limits;
    PollLoop::TimerId m_nextLook;
    PollLoop::TimerId m_rest;
};

}  // namespace kdx::simserver
