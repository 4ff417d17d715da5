#pragma once

#include <chrono>
#include <cstdint>
#include <string>

namespace kdx {

/// A calendar day, as the PC clock shows it.
struct Date {
    int year = 0;
    int month = 0;  ///< 1 to 12
    int day = 0;    ///< 1 to 31
};

/// The PC clock and the only way to wait: handed in wherever time matters, so that tests never sleep.
class Clock {
public:
    virtual ~Clock() = default;
    /// Local time of day in seconds since midnight, with fractions; 0 up to, but not including, 86400.
    [[nodiscard]] virtual double secondsSinceMidnight() const = 0;
    /// Today's local date.
    [[nodiscard]] virtual Date today() const = 0;
    /// A time that only ever runs forward, whatever is done to the PC clock.
    [[nodiscard]] virtual std::chrono::steady_clock::time_point steadyNow() const = 0;
    /// Sleeps for the given time; takes no processor time and handles no events.
    virtual void sleep(std::chrono::nanoseconds duration) = 0;
    /// Whether the last sleep ended early, because whoever is there will not wait any longer.
    [[nodiscard]] virtual bool wasGivenUp() const { return false; }

    /// The user's choice whether a wait over midnight ends like any other; it does not unless chosen.
    void correctMidnight(bool corrected) { m_midnightCorrected = corrected; }
    [[nodiscard]] bool midnightCorrected() const { return m_midnightCorrected; }

private:
    bool m_midnightCorrected = false;
};

/// The machine's clock in its local time zone.
class SystemClock final : public Clock {
public:
    [[nodiscard]] double secondsSinceMidnight() const override;
    [[nodiscard]] Date today() const override;
    [[nodiscard]] std::chrono::steady_clock::time_point steadyNow() const override;
    void sleep(std::chrono::nanoseconds duration) override;
};

/// The clock's time of day as "hh:mm:ss".
[[nodiscard]] std::string timeText(const Clock& clock);
/// The same for a count of seconds since midnight, of the next day too.
[[nodiscard]] std::string timeText(std::chrono::seconds sinceMidnight);

/// Waits until the clock's seconds since midnight, held in single precision, have reached start + milliseconds / 1000.
/// The rounding is the one the instrument's timing was tried out with. A target past midnight is never reached, since
/// the seconds start at 0 again: the wait then does not end, on purpose, unless the clock corrects midnight. Every
/// other wait ends at the latest 100 ms after its length, even when the PC clock is set back meanwhile. One that is
/// given up ends at once.
/// @param milliseconds length of the wait; 0 returns at once.
void WaitMs(Clock& clock, const std::int16_t& milliseconds);

}  // namespace kdx
