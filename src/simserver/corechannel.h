#pragma once

#include "simserver/messagebuffer.h"
#include "simserver/rpcprogram.h"
#include "simserver/vxi11server.h"
#include "simserver/waitingcalls.h"

#include <cstddef>
#include <deque>
#include <functional>
#include <map>
#include <optional>
#include <string>
#include <string_view>

struct Create_LinkParms;
struct Device_ReadParms;
struct Device_WriteParms;
struct Device_LockParms;
struct Device_GenericParms;

namespace kdx::simserver {

/// The VXI-11 core channel: links, their buffers, the device lock, and calls that wait.
class CoreChannel final : public RpcProgram {
public:
    CoreChannel(PollLoop& loop, sim::MessageDevice& device, Vxi11Options options);

    /// The port that clients are told for the abort channel.
    void setAbortPort(unsigned short port) { m_abortPort = port; }

    /// Ends the calls that wait on this link with error 23. @returns 0, or 4 when there is no such link.
    ErrorCode abort(LinkId link);

    void connectionClosed(ConnectionId connection) override;

protected:
    void call(std::uint32_t procedure, std::string_view arguments, ConnectionId from, const RpcReply& reply) override;

private:
    struct Link {
        ConnectionId owner = 0;
        MessageBuffer input;
        std::deque<std::string> output;  ///< response messages not read yet, the first perhaps in part
    };

    void createLink(const Create_LinkParms& parms, const std::string& name, ConnectionId from, const RpcReply& reply);
    void write(const Device_WriteParms& parms, ConnectionId from, const RpcReply& reply);
    void carryOut(LinkId id, Link& link, std::string_view bytes, bool end);
    void read(const Device_ReadParms& parms, ConnectionId from, const RpcReply& reply);
    void lock(const Device_LockParms& parms, ConnectionId from, const RpcReply& reply);
    void readStatusByte(const Device_GenericParms& parms, ConnectionId from, const RpcReply& reply);
    void generic(const Device_GenericParms& parms, ConnectionId from, const RpcReply& reply, const char* name,
                 std::function<ErrorCode(Link&)> action);
    ErrorCode unlock(LinkId id, ConnectionId from);
    ErrorCode destroyLink(LinkId id, ConnectionId from);

    void clear(Link& link);
    void removeLink(LinkId id);
    Link* find(LinkId id, ConnectionId from);
    [[nodiscard]] ErrorCode obstacle(const WaitingCall& call);
    void trace(LinkId link, std::string_view what, std::string_view text = {}) const;

    sim::MessageDevice& m_device;
    Vxi11Options m_options;
    unsigned short m_abortPort = 0;
    std::map<LinkId, Link> m_links;
    LinkId m_lastLink = 0;
    std::optional<LinkId> m_lockHolder;
    WaitingCalls m_calls;
};

}  // namespace kdx::simserver
