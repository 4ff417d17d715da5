#pragma once

#include "base/clock.h"

namespace kdx {

class WorkerVisa;

/// The machine's clock beside a window: a long pause, as one over midnight that never ends, is spent like a call, so
/// that the window is painted meanwhile and the user can give it up.
class PatientClock final : public Clock {
public:
    /// @param worker lent: who waits for its calls waits for the pauses.
    explicit PatientClock(WorkerVisa& worker) : m_worker(worker) {}

    [[nodiscard]] double secondsSinceMidnight() const override { return m_clock.secondsSinceMidnight(); }
    [[nodiscard]] Date today() const override { return m_clock.today(); }
    [[nodiscard]] std::chrono::steady_clock::time_point steadyNow() const override { return m_clock.steadyNow(); }
    void sleep(std::chrono::nanoseconds duration) override;
    [[nodiscard]] bool wasGivenUp() const override { return m_givenUp; }

private:
    WorkerVisa& m_worker;
    SystemClock m_clock;
    bool m_givenUp = false;
};

}  // namespace kdx
