#pragma once

#include <chrono>
#include <optional>
#include <string>
#include <string_view>

#include "sim/errorqueue.h"

namespace kdx {
class Clock;
}

namespace kdx::sim {

/// The clock time that the coder transmits: once set it runs on by itself, in step with the clock handed in.
class CoderClock {
public:
    explicit CoderClock(const Clock& clock) : m_clock(clock) {}

    /// Takes "hh:mm:ss,DD.MM.YY" (years 2000 to 2099), or "off" in any letter case to send none.
    ScpiError set(std::string_view value);
    void stop() { m_lead.reset(); }
    /// The running time in the same form, or "off".
    [[nodiscard]] std::string text() const;
    /// How far it runs ahead of the clock handed in; nothing while it is off.
    [[nodiscard]] std::optional<std::chrono::milliseconds> lead() const { return m_lead; }

private:
    using Time = std::chrono::sys_time<std::chrono::milliseconds>;
    [[nodiscard]] Time now() const;

    const Clock& m_clock;
    std::optional<std::chrono::milliseconds> m_lead;
};

}  // namespace kdx::sim
