#pragma once

#include "base/clock.h"

namespace kdx {

/// A clock whose steady time stands still while it is held: what is to be waited for then is waited for afterwards.
class HeldClock final : public Clock {
public:
    explicit HeldClock(Clock& clock) : m_clock(clock) {}

    [[nodiscard]] double secondsSinceMidnight() const override { return m_clock.secondsSinceMidnight(); }
    [[nodiscard]] Date today() const override { return m_clock.today(); }
    [[nodiscard]] std::chrono::steady_clock::time_point steadyNow() const override {
        return (m_held ? m_heldAt : m_clock.steadyNow()) - m_behind;
    }
    void sleep(std::chrono::nanoseconds duration) override { m_clock.sleep(duration); }

    void setHeld(bool held) {
        if (held == m_held) return;
        if (held) {
            m_heldAt = m_clock.steadyNow();
        } else {
            m_behind += m_clock.steadyNow() - m_heldAt;
        }
        m_held = held;
    }
    [[nodiscard]] bool isHeld() const { return m_held; }

private:
    Clock& m_clock;
    bool m_held = false;
    std::chrono::steady_clock::time_point m_heldAt;
    std::chrono::nanoseconds m_behind{0};
};

}  // namespace kdx
