#include "air/broadcast.h"

#include <utility>

#include "base/codepage.h"
#include "base/printable.h"
#include "sim/scpi.h"

namespace kdx::air {

double AirClock::secondsSinceMidnight() const {
    return std::chrono::duration<double>(m_time - std::chrono::floor<std::chrono::days>(m_time)).count();
}

Date AirClock::today() const {
    const std::chrono::year_month_day date{std::chrono::floor<std::chrono::days>(m_time)};
    return {static_cast<int>(date.year()), static_cast<int>(static_cast<unsigned>(date.month())),
            static_cast<int>(static_cast<unsigned>(date.day()))};
}

std::chrono::steady_clock::time_point AirClock::steadyNow() const {
    using Steady = std::chrono::steady_clock;
    return Steady::time_point{std::chrono::duration_cast<Steady::duration>(m_time.time_since_epoch())};
}

Broadcast::Broadcast(AirTime start, Warn warn) : m_time(start), m_warn(std::move(warn)) {
    m_instrument.onUnit([this](const sim::CommandUnit&, sim::ScpiError error) {
        if (error != sim::ScpiError::None && m_warn)
            m_warn("refused: " + toUtf8(printableLine(m_message, '.')) + " (" + sim::errorAnswer(error) + ")");
    });
}

void Broadcast::execute(std::string_view message, AirTime at) {
    m_clock.set(at);
    m_message = message;
    m_instrument.execute(message);
    if (m_begun) m_composer.take(m_instrument.transmission());
}

OnAir Broadcast::next() {
    if (!std::exchange(m_begun, true)) m_composer.take(m_instrument.transmission());
    return m_composer.next(std::exchange(m_time, m_time + kGroupTime));
}

}  // namespace kdx::air
