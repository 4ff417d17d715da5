#pragma once

#include <rpc/rpc.h>

#include <cstdint>
#include <functional>
#include <string>
#include <string_view>

namespace kdx::simserver {

/// Names the connection that a call comes by. Its upper half is the client's IPv4 address.
using ConnectionId = std::uint64_t;

/// The address that the connection comes from: all that have it count as one peer.
constexpr std::uint32_t peerOf(ConnectionId connection) {
    return static_cast<std::uint32_t>(connection >> 32U);
}

/// What a procedure answers: its results in XDR, or why there are none.
struct RpcAnswer {
    std::string results;
    accept_stat status = SUCCESS;
};

/// Gives the answer to a call, at once or later, once.
using RpcReply = std::function<void(const RpcAnswer&)>;

/// One version of an ONC RPC program: reads calls, turns down what is none of its business, lets the rest be carried
/// out by call().
class RpcProgram {
public:
    RpcProgram(std::uint32_t number, std::uint32_t version) : m_number(number), m_version(version) {}
    RpcProgram(const RpcProgram&) = delete;
    RpcProgram& operator=(const RpcProgram&) = delete;
    virtual ~RpcProgram() = default;

    /// Takes one call message.
    /// @param send gets the reply message, perhaps only after this has returned.
    /// @returns false when the bytes are no call at all, so that nothing can be replied.
    bool handle(std::string_view message, ConnectionId from, std::function<void(std::string)> send);

    /// The connection is gone: no reply reaches it any more.
    virtual void connectionClosed(ConnectionId) {}

    /// Whether the client may keep its connection without a word: because something is kept for it here.
    [[nodiscard]] virtual bool mayBeSilent(ConnectionId) const { return false; }

protected:
    /// Carries out a procedure other than 0, which is the same for all programs.
    virtual void call(std::uint32_t procedure, std::string_view arguments, ConnectionId from,
                      const RpcReply& reply) = 0;

private:
    std::uint32_t m_number;
    std::uint32_t m_version;
};

}  // namespace kdx::simserver
