#include "link/rpcchannel.h"

#include "vxi11/xdr.h"

#include <arpa/inet.h>
#include <netinet/in.h>
#include <netinet/tcp.h>
#include <poll.h>
#include <sys/socket.h>

#include <algorithm>
#include <array>
#include <cerrno>
#include <utility>

namespace kdx {

namespace {

bool wouldBlock() {
    return errno == EAGAIN || errno == EWOULDBLOCK || errno == EINTR;
}

}  // namespace

/// False at the deadline, at the latest.
bool RpcChannel::waitFor(int descriptor, short event, Deadline deadline) const {
    while (!m_aborting) {
        const auto left = std::chrono::ceil<std::chrono::milliseconds>(deadline - std::chrono::steady_clock::now());
        if (left.count() <= 0) return false;  // also when a peer that never stops sending always has something
        pollfd waiting{descriptor, event, 0};
        const int ready = poll(&waiting, 1, static_cast<int>(std::min(left, kAbortLatency).count()));
        if (ready > 0) return true;
        if (ready < 0 && errno != EINTR) return false;
    }
    return false;
}

bool RpcChannel::connect(const sockaddr_in& address, std::uint16_t port, Deadline deadline) {
    FileDescriptor fresh(::socket(AF_INET, SOCK_STREAM | SOCK_NONBLOCK | SOCK_CLOEXEC, IPPROTO_TCP));
    if (!fresh.isOpen()) return false;
    sockaddr_in peer = address;
    peer.sin_port = htons(port);
    if (::connect(fresh.number(), reinterpret_cast<const sockaddr*>(&peer), sizeof peer) != 0) {
        if (errno != EINPROGRESS && errno != EINTR) return false;
        if (!waitFor(fresh.number(), POLLOUT, deadline)) return false;
        int failure = 0;
        socklen_t size = sizeof failure;
        if (getsockopt(fresh.number(), SOL_SOCKET, SO_ERROR, &failure, &size) != 0 || failure != 0) return false;
    }
    const int on = 1;  // a short question must not wait for the acknowledgement of the command before it
    setsockopt(fresh.number(), IPPROTO_TCP, TCP_NODELAY, &on, sizeof on);
    m_socket = std::move(fresh);
    m_received = RecordReader(kLargestReply);
    return true;
}

RpcOutcome RpcChannel::call(std::uint32_t procedure, std::size_t variableBytes, const Coder& arguments,
                            const Coder& results, Deadline deadline) {
    if (!m_socket.isOpen()) return RpcOutcome::Lost;
    ++m_lastCall;
    const auto message = rpcCall({m_lastCall, m_program, m_version, procedure}, variableBytes, arguments);
    if (!message) return RpcOutcome::Failed;
    m_request = framed(*message);
    RpcOutcome outcome = send(deadline);
    if (outcome == RpcOutcome::Done) outcome = receiveReply(deadline);
    if (outcome == RpcOutcome::Done) outcome = readRpcReply(m_reply, results);
    return outcome == RpcOutcome::Unavailable || outcome == RpcOutcome::Failed ? close(outcome) : outcome;
}

RpcOutcome RpcChannel::send(Deadline deadline) {
    std::size_t sent = 0;
    while (sent < m_request.size()) {
        const ssize_t taken = ::send(m_socket.number(), m_request.data() + sent, m_request.size() - sent, MSG_NOSIGNAL);
        if (taken > 0) {
            sent += static_cast<std::size_t>(taken);
        } else if (taken < 0 && !wouldBlock()) {
            return close(RpcOutcome::Lost);
        } else if (!waitFor(m_socket.number(), POLLOUT, deadline)) {
            // The rest of a request begun could not be told from the next one.
            return sent == 0 ? RpcOutcome::TimedOut : close(RpcOutcome::TimedOut);
        }
    }
    return RpcOutcome::Done;
}

/// Leaves the answer to the call under way in m_reply.
RpcOutcome RpcChannel::receiveReply(Deadline deadline) {
    std::array<char, 8192> piece;
    for (;;) {
        while (auto message = m_received.next()) {
            // Calls are numbered from 1: a smaller number is the late answer to a call that was given up.
            const std::uint32_t number = message->size() >= 4 ? xdrWord(*message) : 0;
            if (number == 0 || number > m_lastCall) return close(RpcOutcome::Failed);
            if (number < m_lastCall) continue;
            m_reply = std::move(*message);
            return RpcOutcome::Done;
        }
        if (m_received.broken()) return close(RpcOutcome::Failed);
        if (!waitFor(m_socket.number(), POLLIN, deadline)) return RpcOutcome::TimedOut;
        const ssize_t got = recv(m_socket.number(), piece.data(), piece.size(), 0);
        if (got > 0) {
            m_received.feed({piece.data(), static_cast<std::size_t>(got)});
        } else if (got == 0 || !wouldBlock()) {
            return close(RpcOutcome::Lost);
        }
    }
}

RpcOutcome RpcChannel::close(RpcOutcome because) {
    m_socket.close();
    return because;
}

}  // namespace kdx
