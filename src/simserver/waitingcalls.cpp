#include "simserver/waitingcalls.h"

#include "vxi11/numbers.h"

#include <algorithm>
#include <new>
#include <utility>

namespace kdx::simserver {
namespace {

constexpr std::size_t kMostWaiting = 256;
constexpr std::ptrdiff_t kMostWaitingOfOnePeer = 128;

}  // namespace

void WaitingCalls::start(WaitingCall call) {
    if (advance(call)) return;
    if (!isRoomFor(call.connection)) return call.fail(vxi11::kOutOfResources);
    m_calls.push_back(std::move(call));
    park(std::prev(m_calls.end()));
}

// What one waiting call does may be what another one waits for, so it goes on until none gets any further.
void WaitingCalls::retry() {
    for (bool changed = true; changed;) {
        changed = false;
        for (auto call = m_calls.begin(); call != m_calls.end();) {
            const auto current = call++;
            const bool hadPassed = current->lockPassed;
            if (advanceOrFail(*current)) {
                m_loop.cancel(current->timer);
                m_calls.erase(current);
                changed = true;
            } else if (current->lockPassed != hadPassed) {
                m_loop.cancel(current->timer);
                park(current);
            }
        }
    }
}

void WaitingCalls::abort(LinkId link) {
    for (auto call = m_calls.begin(); call != m_calls.end();) {
        const auto current = call++;
        if (current->link != link) continue;
        m_loop.cancel(current->timer);
        current->fail(vxi11::kAborted);
        m_calls.erase(current);
    }
}

void WaitingCalls::forget(ConnectionId connection) {
    for (auto call = m_calls.begin(); call != m_calls.end();) {
        const auto current = call++;
        if (current->connection != connection) continue;
        m_loop.cancel(current->timer);
        m_calls.erase(current);
    }
}

bool WaitingCalls::anyOf(ConnectionId connection) const {
    return std::any_of(m_calls.begin(), m_calls.end(),
                       [connection](const WaitingCall& call) { return call.connection == connection; });
}

bool WaitingCalls::isRoomFor(ConnectionId connection) const {
    const auto ofThePeer = std::count_if(m_calls.begin(), m_calls.end(), [connection](const WaitingCall& call) {
        return peerOf(call.connection) == peerOf(connection);
    });
    return m_calls.size() < kMostWaiting && ofThePeer < kMostWaitingOfOnePeer;
}

// True: it is done and answered. False: it waits, for the lock until lockPassed, then for data.
bool WaitingCalls::advance(WaitingCall& call) {
    const ErrorCode obstacle = m_gate(call);
    if (obstacle == vxi11::kInvalidLink) {
        call.fail(obstacle);
        return true;
    }
    if (!call.lockPassed && obstacle == vxi11::kLockedByAnotherLink) {
        if (!call.waitForLock) call.fail(obstacle);
        return !call.waitForLock;
    }
    call.lockPassed = true;
    return call.perform();
}

// The caller of the moment is perhaps another client than the one whose call is carried out: it must not suffer when
// memory runs out here.
bool WaitingCalls::advanceOrFail(WaitingCall& call) {
    try {
        return advance(call);
    } catch (const std::bad_alloc&) {
        call.fail(vxi11::kOutOfResources);
        return true;
    }
}

void WaitingCalls::park(Calls::iterator call) {
    const bool forLock = !call->lockPassed;
    const auto timeout = std::min(forLock ? call->lockTimeout : call->ioTimeout, m_longest);
    call->timer = m_loop.callAt(std::chrono::steady_clock::now() + timeout, [this, call, forLock] {
        call->fail(forLock ? vxi11::kLockedByAnotherLink : vxi11::kIoTimeout);
        m_calls.erase(call);
    });
}

}  // namespace kdx::simserver
