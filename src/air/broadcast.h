#pragma once

#include <string>
#include <string_view>

#include "air/airtime.h"
#include "air/composer.h"
#include "base/clock.h"
#include "sim/virtualinstrument.h"

namespace kdx::air {

/// A clock that stands at a time of the air.
class AirClock final : public Clock {
public:
    explicit AirClock(AirTime time) : m_time(time) {}
    void set(AirTime time) { m_time = time; }

    [[nodiscard]] double secondsSinceMidnight() const override;
    [[nodiscard]] Date today() const override;
    [[nodiscard]] std::chrono::steady_clock::time_point steadyNow() const override;
    void sleep(std::chrono::nanoseconds) override {}

private:
    AirTime m_time;
};

/// A virtual instrument, as after switching on, and what it sends from a given time on, whatever the machine's clock
/// says.
class Broadcast {
public:
    /// @param warn hears also of commands that the instrument refuses.
    Broadcast(AirTime start, Warn warn);
    Broadcast(const Broadcast&) = delete;
    Broadcast& operator=(const Broadcast&) = delete;

    /// Carries out a program message, which shows from the next group on. @param at not before the last one's.
    void execute(std::string_view message, AirTime at);

    /// When the next group begins.
    [[nodiscard]] AirTime time() const { return m_time; }
    /// What goes out for the length of a group, which is over then.
    OnAir next();
    /// What the instrument is set to.
    [[nodiscard]] const sim::InstrumentSettings& settings() const { return m_instrument.transmission().settings; }

private:
    AirTime m_time;
    AirClock m_clock{m_time};
    Warn m_warn;
    Composer m_composer{m_warn};
    sim::VirtualInstrument m_instrument{m_clock};
    std::string m_message;  ///< under way
    bool m_begun = false;
};

}  // namespace kdx::air
