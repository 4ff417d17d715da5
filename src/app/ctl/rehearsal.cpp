#include "app/ctl/rehearsal.h"

#include <cmath>

namespace kdx::ctl {

double HastyClock::secondsSinceMidnight() const {
    constexpr double kDay = 86400;
    return std::fmod(m_clock.secondsSinceMidnight() + std::chrono::duration<double>(m_skipped).count(), kDay);
}

std::chrono::steady_clock::time_point HastyClock::steadyNow() const {
    return m_clock.steadyNow() + m_skipped;
}

Rehearsal::Rehearsal(DataFolder& data, const Captions& captions)
    : m_session(m_visa, m_state, data, captions, m_clock, [this] { m_session.transmitter.stop(); }) {
    m_session.instrument.addWatcher(*this);
}

void Rehearsal::apply(const Profile& source) {
    m_session.load(source);
    m_clock.correctMidnight(true);
    m_session.open("TCPIP", "rehearsal");
    m_session.sendOpening();
    m_session.close();
}

void Rehearsal::passed(const Traffic& traffic) {
    if (traffic.kind == Traffic::Kind::Written) m_commands.push_back(traffic.text);
}

}  // namespace kdx::ctl
