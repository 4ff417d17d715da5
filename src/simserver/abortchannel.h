#pragma once

#include "simserver/rpcprogram.h"

namespace kdx::simserver {

class CoreChannel;

/// The VXI-11 abort channel: by it a client ends a call of its own that still waits on the core channel.
class AbortChannel final : public RpcProgram {
public:
    explicit AbortChannel(CoreChannel& core);

    /// A client that has a link may want to abort a call on it at any time.
    [[nodiscard]] bool mayBeSilent(ConnectionId connection) const override;

protected:
    void call(std::uint32_t procedure, std::string_view arguments, ConnectionId from, const RpcReply& reply) override;

private:
    CoreChannel& m_core;
};

}  // namespace kdx::simserver
