#pragma once

#include <string>
#include <vector>

#include "base/clock.h"
#include "settings/programstate.h"
#include "sim/simvisa.h"
#include "sim/virtualinstrument.h"
#include "station/session.h"

namespace kdx::ctl {

/// The machine's clock with pauses that take no time.
class HastyClock final : public Clock {
public:
    [[nodiscard]] double secondsSinceMidnight() const override;
    [[nodiscard]] Date today() const override { return m_clock.today(); }
    [[nodiscard]] std::chrono::steady_clock::time_point steadyNow() const override;
    void sleep(std::chrono::nanoseconds duration) override { m_skipped += duration; }

private:
    SystemClock m_clock;
    std::chrono::nanoseconds m_skipped{0};
};

/// A data set sent to a virtual instrument of its own: what would go out, and what the instrument would make of it.
class Rehearsal : private TrafficWatcher {
public:
    Rehearsal(DataFolder& data, const Captions& captions);
    ~Rehearsal() override { m_session.instrument.removeWatcher(*this); }
    Rehearsal(const Rehearsal&) = delete;
    Rehearsal& operator=(const Rehearsal&) = delete;

    /// Opens the session, sends what belongs to the opening, closes it.
    void apply(const Profile& source);
    /// What was written, in its order.
    [[nodiscard]] const std::vector<std::string>& commands() const { return m_commands; }

private:
    void passed(const Traffic& traffic) override;

    HastyClock m_clock;
    sim::VirtualInstrument m_instrument{m_clock};
    sim::SimVisa m_visa{m_instrument};
    ProgramState m_state;
    std::vector<std::string> m_commands;
    Session m_session;
};

}  // namespace kdx::ctl
