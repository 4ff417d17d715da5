#pragma once

#include "simserver/pollloop.h"
#include "simserver/rpcprogram.h"
#include "simserver/vxi11server.h"

#include <chrono>
#include <functional>
#include <list>
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
/// A call that cannot be answered yet is parked: other calls, of the same client too, are served meanwhile.
class CoreChannel final : public RpcProgram {
public:
    using LinkId = long;
    using ErrorCode = long;  ///< Device_ErrorCode of the standard; 0: no error

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
        std::string input;   // of a program message whose END has not come yet
        std::string output;  // what has not been read yet of the response message
    };
    /// A call that may have to wait: first until no other link has the lock, then (reads only) until there are data.
    struct Operation {
        ConnectionId connection = 0;
        std::optional<LinkId> link;  // none: create_link
        bool waitForLock = false;
        std::chrono::milliseconds lockTimeout{};
        std::chrono::milliseconds ioTimeout{};
        std::function<bool()> perform;  // does it and replies; false: there is nothing to read yet
        std::function<void(ErrorCode)> fail;
        bool lockPassed = false;
        PollLoop::TimerId timer{};
    };
    using Parked = std::list<Operation>;

    void createLink(const Create_LinkParms& parms, ConnectionId from, const RpcReply& reply);
    void write(const Device_WriteParms& parms, ConnectionId from, const RpcReply& reply);
    void read(const Device_ReadParms& parms, ConnectionId from, const RpcReply& reply);
    void lock(const Device_LockParms& parms, ConnectionId from, const RpcReply& reply);
    void readStatusByte(const Device_GenericParms& parms, ConnectionId from, const RpcReply& reply);
    void generic(const Device_GenericParms& parms, ConnectionId from, const RpcReply& reply, const char* name,
                 std::function<void(Link&)> action);
    ErrorCode unlock(LinkId id, ConnectionId from);
    ErrorCode destroyLink(LinkId id, ConnectionId from);

    void start(Operation operation);
    bool advance(Operation& operation);
    void park(Parked::iterator operation);
    void retryParked();
    void clear(Link& link);
    void removeLink(LinkId id);
    Link* find(LinkId id, ConnectionId from);
    [[nodiscard]] bool lockedAgainst(std::optional<LinkId> link) const;
    void trace(LinkId link, std::string_view what, std::string_view text = {}) const;

    PollLoop& m_loop;
    sim::MessageDevice& m_device;
    Vxi11Options m_options;
    unsigned short m_abortPort = 0;
    std::map<LinkId, Link> m_links;
    LinkId m_lastLink = 0;
    std::optional<LinkId> m_lockHolder;
    Parked m_parked;
};

}  // namespace kdx::simserver
