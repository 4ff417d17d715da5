#pragma once

#include <functional>
#include <string>
#include <vector>

#include "base/clock.h"
#include "settings/programstate.h"
#include "sim/simvisa.h"
#include "sim/virtualinstrument.h"
#include "station/readout.h"
#include "station/session.h"

namespace kdx {

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

/// A virtual instrument of its own, as after switching on, to try out what a data set would do.
class Rehearsal : private TrafficWatcher {
public:
    Rehearsal(DataFolder& data, const Captions& captions);
    ~Rehearsal() override { m_session.instrument.removeWatcher(*this); }
    Rehearsal(const Rehearsal&) = delete;
    Rehearsal& operator=(const Rehearsal&) = delete;

    /// Gives it the values of another instrument, as far as it takes them.
    void become(const Readout& other);
    /// Opens the session, sends what belongs to the opening, closes it.
    void apply(const Profile& source);
    /// The same with what the window has.
    void apply(Station entered);
    /// What it has now.
    [[nodiscard]] Readout readOut();

    /// What apply() has written, in its order.
    [[nodiscard]] const std::vector<std::string>& commands() const { return m_commands; }

private:
    void passed(const Traffic& traffic) override;
    void open();
    void play(const std::function<void()>& opening);

    const Captions& m_captions;
    HastyClock m_clock;
    sim::VirtualInstrument m_instrument{m_clock};
    sim::SimVisa m_visa{m_instrument};
    ProgramState m_state;
    std::vector<std::string> m_commands;
    bool m_applies = false;
    Session m_session;
};

}  // namespace kdx
