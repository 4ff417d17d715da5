#pragma once

#include "simserver/messagebuffer.h"
#include "simserver/rpcprogram.h"
#include "simserver/vxi11server.h"
#include "simserver/waitingcalls.h"

#include <cstddef>
#include <cstdint>
#include <deque>
#include <functional>
#include <map>
#include <optional>
#include <random>
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
    [[nodiscard]] bool mayBeSilent(ConnectionId connection) const override;
    /// How many links clients at that address have.
    [[nodiscard]] std::size_t linksOf(std::uint32_t peer) const;

protected:
    void call(std::uint32_t procedure, std::string_view arguments, ConnectionId from, const RpcReply& reply) override;

private:
    struct Link {
        ConnectionId owner = 0;
        unsigned long number = 0;  ///< for the trace: links count from 1
        MessageBuffer input;
        bool overtakes = false;          ///< the message under way began while answers were unread
        std::deque<std::string> output;  ///< response messages not read yet, the first perhaps in part
    };

    void createLink(const Create_LinkParms& parms, const std::string& name, ConnectionId from, const RpcReply& reply);
    void write(const Device_WriteParms& parms, ConnectionId from, const RpcReply& reply);
    void carryOut(LinkId id, Link& link, std::string_view bytes, bool end);
    void dropOvertaken(LinkId id, Link& link);
    void read(const Device_ReadParms& parms, ConnectionId from, const RpcReply& reply);
    void lock(const Device_LockParms& parms, ConnectionId from, const RpcReply& reply);
    void readStatusByte(const Device_GenericParms& parms, ConnectionId from, const RpcReply& reply);
    void generic(const Device_GenericParms& parms, ConnectionId from, const RpcReply& reply, const char* name,
                 std::function<ErrorCode(Link&)> action);
    ErrorCode unlock(LinkId id, ConnectionId from);
    ErrorCode destroyLink(LinkId id, ConnectionId from);

    [[nodiscard]] bool isRoomFor(ConnectionId connection) const;
    LinkId freeId();
    void clear(Link& link);
    void removeLink(LinkId id, std::string_view how);
    Link* find(LinkId id, ConnectionId from);
    [[nodiscard]] ErrorCode obstacle(const WaitingCall& call);
    void trace(LinkId link, std::string_view what, std::string_view text = {}) const;

    sim::MessageDevice& m_device;
    Vxi11Options m_options;
    unsigned short m_abortPort = 0;
    std::map<LinkId, Link> m_links;
    unsigned long m_lastNumber = 0;
    std::random_device m_random;
    std::optional<LinkId> m_lockHolder;
    WaitingCalls m_calls;
};

}  // namespace kdx::simserver
