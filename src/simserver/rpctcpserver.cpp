#include "simserver/rpctcpserver.h"

#include <netinet/in.h>
#include <netinet/tcp.h>
#include <poll.h>
#include <sys/socket.h>

#include <algorithm>
#include <array>
#include <cerrno>
#include <new>
#include <utility>
#include <vector>

namespace kdx::simserver {
namespace {

using std::chrono::steady_clock;

// A client that does not fetch its replies gets no further calls served once this much is waiting for it.
constexpr std::size_t kMostUnsent = std::size_t{1024} * 1024;

// For so long nobody is accepted when the system has no descriptor left for him.
constexpr std::chrono::seconds kRest{1};

void setOption(int socket, int level, int option, int value) {
    setsockopt(socket, level, option, &value, sizeof value);
}

// Replies are small and awaited, so they go out at once; a client that vanished without a word (power cut, cable) is
// noticed after about a minute, and its links and locks are freed.
void setUp(int socket) {
    setOption(socket, IPPROTO_TCP, TCP_NODELAY, 1);
    setOption(socket, SOL_SOCKET, SO_KEEPALIVE, 1);
    setOption(socket, IPPROTO_TCP, TCP_KEEPIDLE, 30);
    setOption(socket, IPPROTO_TCP, TCP_KEEPINTVL, 10);
    setOption(socket, IPPROTO_TCP, TCP_KEEPCNT, 3);
}

}  // namespace

RpcTcpServer::RpcTcpServer(PollLoop& loop, RpcProgram& program, const std::string& address, unsigned short port,
                           SilenceLimits limits)
    : RpcTcpServer(loop, program, listenTcp(address, port), std::move(limits)) {}

RpcTcpServer::RpcTcpServer(PollLoop& loop, RpcProgram& program, FileDescriptor listener, SilenceLimits limits)
    : m_loop(loop), m_program(program), m_listener(std::move(listener)), m_limits(std::move(limits)) {
    m_loop.watch(m_listener.number(), POLLIN, [this](short) { acceptClient(); });
    closeStuck();
}

RpcTcpServer::~RpcTcpServer() {
    m_loop.cancel(m_nextLook);
    m_loop.cancel(m_rest);
    m_loop.forget(m_listener.number());
    for (const auto& [id, connection] : m_connections) m_loop.forget(connection.socket.number());
}

void RpcTcpServer::acceptClient() {
    sockaddr_in name{};
    socklen_t length = sizeof name;
    FileDescriptor socket(
        ::accept4(m_listener.number(), reinterpret_cast<sockaddr*>(&name), &length, SOCK_NONBLOCK | SOCK_CLOEXEC));
    if (!socket.isOpen()) {
        // Otherwise the client has given up meanwhile.
        if (errno == EMFILE || errno == ENFILE || errno == ENOBUFS || errno == ENOMEM) restFromAccepting();
        return;
    }
    const std::uint32_t peer = ntohl(name.sin_addr.s_addr);
    if (connectionsOf(peer) >= kMostOfOnePeer) return;
    setUp(socket.number());
    const ConnectionId id = ConnectionId{peer} << 32U | ++m_lastSerial;
    Connection& connection = m_connections[id];
    connection.socket = std::move(socket);
    connection.movedOn = m_limits.now();
    m_loop.watch(connection.socket.number(), POLLIN, [this, id](short events) { serve(id, events); });
    if (m_connections.size() >= kMostConnections) m_loop.setEvents(m_listener.number(), 0);
}

// The client stays in the queue, and the listener would be ready at once again, ever after.
void RpcTcpServer::restFromAccepting() {
    m_loop.setEvents(m_listener.number(), 0);
    m_loop.cancel(m_rest);
    m_rest = m_loop.callAt(steady_clock::now() + kRest, [this] {
        if (m_connections.size() < kMostConnections) m_loop.setEvents(m_listener.number(), POLLIN);
    });
}

std::size_t RpcTcpServer::connectionsOf(std::uint32_t peer) const {
    return static_cast<std::size_t>(std::count_if(m_connections.begin(), m_connections.end(),
                                                  [peer](const auto& entry) { return peerOf(entry.first) == peer; }));
}

// Looks often enough that none stays much longer than it may.
void RpcTcpServer::closeStuck() {
    const auto now = m_limits.now();
    std::vector<ConnectionId> stuck;
    for (const auto& [id, connection] : m_connections) {
        const bool underWay = connection.reader.hasBegun() || !connection.unsent.empty();
        const bool mayBeSilent = !underWay && m_program.mayBeSilent(id);
        if (now - connection.movedOn > (mayBeSilent ? m_limits.longestSilence : m_limits.patience)) stuck.push_back(id);
    }
    for (const ConnectionId id : stuck) close(id);
    m_nextLook = m_loop.callAt(steady_clock::now() + m_limits.patience / 4, [this] { closeStuck(); });
}

void RpcTcpServer::serve(ConnectionId id, short events) {
    try {
        serveEvents(id, events);
    } catch (const std::bad_alloc&) {
        close(id);
    }
}

void RpcTcpServer::serveEvents(ConnectionId id, short events) {
    Connection& connection = m_connections.at(id);
    if ((events & POLLIN) != 0) {
        readCalls(id, connection);
    } else if ((events & (POLLERR | POLLHUP | POLLNVAL)) != 0) {
        close(id);
        return;
    }
    if (!sendUnsent(connection) || (connection.inputEnded && connection.unsent.empty())) {
        close(id);
        return;
    }
    updateEvents(connection);
}

void RpcTcpServer::readCalls(ConnectionId id, Connection& connection) {
    std::array<char, 65536> bytes;
    const ssize_t count = ::recv(connection.socket.number(), bytes.data(), bytes.size(), 0);
    if (count < 0 && (errno == EAGAIN || errno == EWOULDBLOCK || errno == EINTR)) return;
    if (count <= 0) {
        endInput(id, connection);
        return;
    }
    if (!connection.reader.hasBegun()) connection.movedOn = m_limits.now();
    connection.reader.feed({bytes.data(), static_cast<std::size_t>(count)});
    while (const auto record = connection.reader.next()) {
        connection.movedOn = m_limits.now();
        const bool isCall =
            m_program.handle(*record, id, [this, id](const std::string& reply) { sendRecord(id, reply); });
        if (!isCall) {
            endInput(id, connection);
            return;
        }
    }
    if (connection.reader.broken()) endInput(id, connection);
}

// What has been answered still goes out; what the program keeps for the client is given up.
void RpcTcpServer::endInput(ConnectionId id, Connection& connection) {
    connection.inputEnded = true;
    m_program.connectionClosed(id);
}

void RpcTcpServer::sendRecord(ConnectionId id, const std::string& record) {
    const auto found = m_connections.find(id);
    if (found == m_connections.end()) return;
    Connection& connection = found->second;
    // A connection that fails here is closed when the loop sees it: whoever answers may be in the midst of its own
    // work, or of another client's.
    try {
        connection.unsent += framed(record);
    } catch (const std::bad_alloc&) {
        ::shutdown(connection.socket.number(), SHUT_RDWR);
        return;
    }
    sendUnsent(connection);
    updateEvents(connection);
}

bool RpcTcpServer::sendUnsent(Connection& connection) const {
    while (!connection.unsent.empty()) {
        const ssize_t count =
            ::send(connection.socket.number(), connection.unsent.data(), connection.unsent.size(), MSG_NOSIGNAL);
        if (count < 0) return errno == EAGAIN || errno == EWOULDBLOCK || errno == EINTR;
        connection.unsent.erase(0, static_cast<std::size_t>(count));
        connection.movedOn = m_limits.now();
    }
    return true;
}

void RpcTcpServer::updateEvents(const Connection& connection) {
    int events = 0;
    if (!connection.inputEnded && connection.unsent.size() < kMostUnsent) events |= POLLIN;
    if (!connection.unsent.empty()) events |= POLLOUT;
    m_loop.setEvents(connection.socket.number(), static_cast<short>(events));
}

void RpcTcpServer::close(ConnectionId id) {
    const auto found = m_connections.find(id);
    if (!found->second.inputEnded) m_program.connectionClosed(id);
    m_loop.forget(found->second.socket.number());
    m_connections.erase(found);
    m_loop.setEvents(m_listener.number(), POLLIN);
}

}  // namespace kdx::simserver
