#pragma once

#include "base/clock.h"

namespace kdx::ctl {

/// The machine's clock, which a rehearsal may let run faster: all pauses take less time than they say then.
class PacedClock final : public Clock {
public:
    [[nodiscard]] double secondsSinceMidnight() const override;
    [[nodiscard]] Date today() const override;
    [[nodiscard]] std::chrono::steady_clock::time_point steadyNow() const override;
    void sleep(std::chrono::nanoseconds duration) override;

    /// From now on time runs so many times as fast.
    void hasten(double factor);

private:
    using Duration = std::chrono::duration<double, std::nano>;

    /// How far it is ahead of the machine's.
    [[nodiscard]] std::chrono::nanoseconds ahead() const;

    SystemClock m_clock;
    double m_factor = 1;
    std::chrono::steady_clock::time_point m_begin;
};

}  // namespace kdx::ctl
