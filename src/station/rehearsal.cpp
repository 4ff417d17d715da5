#include "station/rehearsal.h"

#include <cmath>

#include "link/resource.h"

namespace kdx {

double HastyClock::secondsSinceMidnight() const {
    constexpr double kDay = 86400;
    return std::fmod(m_clock.secondsSinceMidnight() + std::chrono::duration<double>(m_skipped).count(), kDay);
}

std::chrono::steady_clock::time_point HastyClock::steadyNow() const {
    return m_clock.steadyNow() + m_skipped;
}

Rehearsal::Rehearsal(DataFolder& data, const Captions& captions)
    : m_captions(captions),
      m_session(m_visa, m_state, data, captions, m_clock, [this] { m_session.transmitter.stop(); }) {
    m_session.instrument.addWatcher(*this);
    m_session.readCorrections();
}

void Rehearsal::become(const Readout& other) {
    const SettingCommands commands = commandsFor(differences(other, readOut()), other, m_state.corrections);
    open();
    for (const auto& [key, command] : commands) m_session.params.sendCommand(key, command);
    m_session.close();
}

void Rehearsal::apply(const Profile& source) {
    m_session.load(source);
    play([this] { m_session.sendOpening(); });
}

void Rehearsal::apply(Station entered) {
    const Corrections& corrections = m_state.corrections;
    m_state.eonIdentifier = entered.otherNetwork.pi;  // leads every command about the network
    if (corrections.eonType) entered.otherNetwork.pty = programmeTypeNumber(entered.otherNetwork.pty, m_captions);
    play([&] { m_session.transmitter.run(openingSteps(entered, corrections)); });
}

void Rehearsal::play(const std::function<void()>& opening) {
    open();
    m_applies = true;
    opening();
    m_applies = false;
    m_session.close();
}

Readout Rehearsal::readOut() {
    open();
    Readout readout = kdx::readOut(m_session.instrument);
    m_session.close();
    return readout;
}

void Rehearsal::open() {
    m_clock.correctMidnight(true);
    m_session.open(kLanInterface, "rehearsal");
}

void Rehearsal::passed(const Traffic& traffic) {
    if (m_applies && traffic.kind == Traffic::Kind::Written) m_commands.push_back(traffic.text);
}

}  // namespace kdx
