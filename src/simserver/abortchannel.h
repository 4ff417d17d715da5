#pragma once

#include "simserver/rpcprogram.h"

namespace kdx::simserver {

class CoreChannel;

/// The VXI-11 abort channel: by it a client ends a call of its own that still waits on the core channel.
class AbortChannel final : public RpcProgram {
public:
    explicit AbortChannel(CoreChannel& core);

protected:
    void call(std::uint32_t procedure, std::string_view arguments, ConnectionId from, const RpcReply& reply) override;

private:
    CoreChannel& m_core;
};

}  // namespace kdx::simserver
