#pragma once

#include "simserver/pollloop.h"
#include "simserver/rpcprogram.h"

#include <chrono>
#include <functional>
#include <list>
#include <optional>

namespace kdx::simserver {

using LinkId = long;
using ErrorCode = long;  ///< Device_ErrorCode of the standard; 0: no error

/// A call that may have to wait: first until no other link has the lock, then (reads only) until there are data.
struct WaitingCall {
    ConnectionId connection = 0;
    std::optional<LinkId> link = std::nullopt;  ///< none: create_link
    bool waitForLock = false;
    std::chrono::milliseconds lockTimeout{};
    std::chrono::milliseconds ioTimeout{};
    std::function<bool()> perform;        ///< does it and replies; false: there is nothing to read yet
    std::function<void(ErrorCode)> fail;  ///< replies so
    bool lockPassed = false;              ///< kept by WaitingCalls, like what follows
    PollLoop::TimerId timer{};
};

/// The calls on a core channel, carried out at once or as soon as they can be. While one waits, other calls, of the
/// same client too, are served.
class WaitingCalls {
public:
    /// Says what stands in a call's way: 4 when its link is gone, 11 when another link has the lock, else 0.
    using Gate = std::function<ErrorCode(const WaitingCall&)>;

    /// @param longest no call waits longer for the lock, and then for data, whatever its time-outs are.
    WaitingCalls(PollLoop& loop, Gate gate, std::chrono::milliseconds longest)
        : m_loop(loop), m_gate(std::move(gate)), m_longest(longest) {}

    /// Carries the call out or lets it wait; it fails with error 9 when too many wait, or too many of one address.
    void start(WaitingCall call);
    /// Lets those go on that can by now; to be called whenever links, lock or answers may have changed.
    void retry();
    /// Ends the calls that wait on this link with error 23.
    void abort(LinkId link);
    /// Forgets the calls of a connection, to which nothing can be replied any more.
    void forget(ConnectionId connection);
    [[nodiscard]] bool anyOf(ConnectionId connection) const;

private:
    using Calls = std::list<WaitingCall>;

    bool advance(WaitingCall& call);
    bool advanceOrFail(WaitingCall& call);
    void park(Calls::iterator call);
    [[nodiscard]] bool isRoomFor(ConnectionId connection) const;

    PollLoop& m_loop;
    Gate m_gate;
    std::chrono::milliseconds m_longest;
    Calls m_calls;
};

}  // namespace kdx::simserver
