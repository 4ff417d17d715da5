#pragma once

#include <cmath>
#include <vector>

#include "base/clock.h"

namespace kdx::test {

/// A clock that stands still until a sleep or the test moves it. At midnight the seconds start again at 0 and the day
/// changes, as on a PC. The steady time runs with it but does not follow when the clock is set.
class FakeClock final : public Clock {
public:
    explicit FakeClock(double seconds = 12 * 3600.0, Date date = {2009, 3, 5}) : m_seconds(seconds), m_date(date) {}

    [[nodiscard]] double secondsSinceMidnight() const override { return m_seconds; }
    [[nodiscard]] Date today() const override { return m_date; }
    [[nodiscard]] std::chrono::steady_clock::time_point steadyNow() const override { return m_steady; }
    void sleep(std::chrono::nanoseconds duration) override {
        sleeps.push_back(duration);
        advance(duration);
    }

    void advance(std::chrono::nanoseconds duration) {
        m_steady += duration;
        m_seconds += std::chrono::duration<double>(duration).count();
        while (m_seconds >= 86400.0) {
            m_seconds -= 86400.0;
            ++m_date.day;
        }
    }
    void set(double seconds) { m_seconds = seconds; }
    void setDate(Date date) { m_date = date; }
    /// All time slept so far, in milliseconds.
    [[nodiscard]] double sleptMs() const {
        double sum = 0;
        for (const auto sleep : sleeps) sum += std::chrono::duration<double, std::milli>(sleep).count();
        return sum;
    }

    std::vector<std::chrono::nanoseconds> sleeps;

private:
    double m_seconds;
    Date m_date;
    std::chrono::steady_clock::time_point m_steady{std::chrono::hours(1)};
};

}  // namespace kdx::test
