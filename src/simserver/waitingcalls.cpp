#include "simserver/waitingcalls.h"

#include "vxi11/numbers.h"

#include <new>
#include <utility>

namespace kdx::simserver {
namespace {

constexpr std::size_t kMostWaiting = 256;

}  // namespace

void WaitingCalls::start(WaitingCall call) {
    if (advance(call)) return;
    if (m_calls.size() >= kMostWaiting) return call.fail(vxi11::kOutOfResources);
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
    const auto timeout = forLock ? call->lockTimeout : call->ioTimeout;
    call->timer = m_loop.callAt(std::chrono::steady_clock::now() + timeout, [this, call, forLock] {
        call->fail(forLock ? vxi11::kLockedByAnotherLink : vxi11::kIoTimeout);
        m_calls.erase(call);
    });
}

}  // namespace kdx::simserver
