#include "simserver/abortchannel.h"

#include "simserver/corechannel.h"
#include "simserver/tirpcxdr.h"

#include <vxi11.h>

namespace kdx::simserver {

AbortChannel::AbortChannel(CoreChannel& core) : RpcProgram(DEVICE_ASYNC, DEVICE_ASYNC_VERSION), m_core(core) {}

bool AbortChannel::mayBeSilent(ConnectionId connection) const {
    return m_core.linksOf(peerOf(connection)) > 0;
}

void AbortChannel::call(std::uint32_t procedure, std::string_view arguments, ConnectionId, const RpcReply& reply) {
    if (procedure != device_abort) return reply({{}, PROC_UNAVAIL});
    const XdrDecoded<Device_Link> link(arguments, xdr_Device_Link);
    if (!link) return reply({{}, GARBAGE_ARGS});
    reply({toXdr<Device_Error>({m_core.abort(*link)}, xdr_Device_Error)});
}

}  // namespace kdx::simserver
