#include "link/rpcchannel.h"

#include "vxi11/xdr.h"

#include <algorithm>
#include <array>
#include <utility>

namespace kdx {

/// False at the deadline, at the latest.
bool RpcChannel::waitFor(const Socket& socket, Socket::Ready ready, Deadline deadline) const {
    while (!m_aborting) {
        const auto left = std::chrono::ceil<std::chrono::milliseconds>(deadline - std::chrono::steady_clock::now());
        if (left.count() <= 0) return false;  // also when a peer that never stops sending always has something
        if (socket.waitFor(ready, std::min(left, kAbortLatency))) return true;
    }
    return false;
}

bool RpcChannel::connect(Ipv4Address address, std::uint16_t port, Deadline deadline) {
    Socket fresh = Socket::connecting(address, port);
    if (!fresh.isOpen() || !waitFor(fresh, Socket::Ready::ToWrite, deadline) || !fresh.isConnected()) return false;
    m_socket = std::move(fresh);
    m_received = RecordReader(kLargestReply);
    return true;
}

RpcOutcome RpcChannel::call(std::uint32_t procedure, std::string_view arguments, const RpcResults& results,
                            Deadline deadline) {
    if (!m_socket.isOpen()) return RpcOutcome::Lost;
    ++m_lastCall;
    m_request = framed(rpcCall({m_lastCall, m_program, m_version, procedure}, arguments));
    RpcOutcome outcome = send(deadline);
    if (outcome == RpcOutcome::Done) outcome = receiveReply(deadline);
    if (outcome == RpcOutcome::Done) outcome = readRpcReply(m_reply, results);
    return outcome == RpcOutcome::Unavailable || outcome == RpcOutcome::Failed ? close(outcome) : outcome;
}

RpcOutcome RpcChannel::send(Deadline deadline) {
    std::string_view left = m_request;
    while (!left.empty()) {
        std::size_t sent = 0;
        switch (m_socket.send(left, sent)) {
            case Socket::Transfer::Some:
                left.remove_prefix(sent);
                break;
            case Socket::Transfer::Lost:
                return close(RpcOutcome::Lost);
            case Socket::Transfer::Later:
                if (waitFor(m_socket, Socket::Ready::ToWrite, deadline)) break;
                // The rest of a request begun could not be told from the next one.
                return left.size() == m_request.size() ? RpcOutcome::TimedOut : close(RpcOutcome::TimedOut);
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
        if (!waitFor(m_socket, Socket::Ready::ToRead, deadline)) return RpcOutcome::TimedOut;
        std::size_t got = 0;
        const Socket::Transfer transfer = m_socket.receive(piece, got);
        if (transfer == Socket::Transfer::Lost) return close(RpcOutcome::Lost);
        if (transfer == Socket::Transfer::Some) m_received.feed({piece.data(), got});
    }
}

RpcOutcome RpcChannel::close(RpcOutcome because) {
    m_socket.close();
    return because;
}

}  // namespace kdx
