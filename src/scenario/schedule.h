#pragma once

#include <chrono>

#include "base/clock.h"

namespace kdx::scenario {

/// When each step is due. A wait counts from when the step before it was due, not from when that was done: what
/// commands take does not add up, however many there are. Where a step is done only after the next one was due (a
/// person thought, the instrument kept silent), the schedule goes on from then: what was missed is not made up for in
/// haste.
class Schedule {
public:
    using Time = std::chrono::steady_clock::time_point;

    explicit Schedule(const Clock& clock) : m_clock(clock), m_due(clock.steadyNow()) {}

    /// Until when the next step is to be waited for.
    [[nodiscard]] Time due() const { return m_due; }
    /// The next step is due so much later.
    void wait(std::chrono::nanoseconds length) { waitUntil(m_due + length); }
    /// The next step is due then, unless it is later already.
    void waitUntil(Time time) {
        if (time > m_due) m_due = time;
        if (const Time now = m_clock.steadyNow(); now > m_due) m_due = now;
    }
    /// The next step is due now: nobody could say before how long this one takes.
    void goOnFromNow() { m_due = m_clock.steadyNow(); }

private:
    const Clock& m_clock;
    Time m_due;
};

}  // namespace kdx::scenario
