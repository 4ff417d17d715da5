#pragma once

#include <memory>
#include <optional>
#include <string>

#include "app/choosevisa.h"
#include "app/ctl/call.h"
#include "app/ctl/output.h"
#include "app/ctl/pacedclock.h"
#include "settings/captions.h"
#include "settings/datafolder.h"
#include "settings/programstate.h"
#include "station/session.h"

namespace kdx::ctl {

/// What the subcommands work with: the data folder, one session, and how failures are told. The session is closed
/// however the program ends.
class Laboratory : private TrafficWatcher, private StepWatcher {
public:
    /// @param program the name it was called by; @param stop a descriptor that is readable once the user wants to stop.
    Laboratory(const Call& call, Output& output, const char* program, int stop);
    ~Laboratory() override;
    Laboratory(const Laboratory&) = delete;
    Laboratory& operator=(const Laboratory&) = delete;

    /// Opens the session; a failure is told. False then.
    [[nodiscard]] bool open();
    /// Closes it, unless it is held.
    void close();
    /// One session for several tasks: open() finds it open, close() leaves it so.
    void hold() { m_held = true; }
    /// The failures of the task before are over; a link that was lost is made anew by open().
    void nextTask();
    /// So many commands come now, which are counted anew; 0: as many as there are.
    void expect(std::size_t commands);
    /// Waits; false when the user wants to stop, at once then.
    bool pause(std::chrono::milliseconds duration);
    /// After a command outside of steps: whether to go on with the next.
    [[nodiscard]] bool goesOn();
    /// kDone, kFailed when anything failed or was stopped, or kDifferent when a list was refused.
    [[nodiscard]] int result() const;
    /// Checks a value, as typed, against what is legal for the key; what is wrong is told, unless the call is forced.
    [[nodiscard]] bool mayBeSent(const std::string& key, const std::string& utf8);
    /// Checks all that a data set sends; what is wrong is told, unless the call is to be forced.
    [[nodiscard]] bool mayBeSent(const Profile& source);
    /// Whether the run was stopped, or the user wants to; that is told.
    [[nodiscard]] bool isStopped();
    /// From here on a wish to stop is let be: what is sent puts things back.
    void finish() { m_finishing = true; }
    /// Lets time run faster, for the virtual instrument inside too.
    void hasten(double factor) { m_clock.hasten(factor); }
    /// Lets the session be when the program ends.
    void keepOpen() { m_session->keepOpen(); }
    [[nodiscard]] int stop() const { return m_stop; }
    /// What instruments are reached by, where there is a session.
    [[nodiscard]] Visa& visa() const { return *m_link.visa; }
    [[nodiscard]] const Call& call() const { return m_call; }
    [[nodiscard]] Output& output() { return m_output; }
    [[nodiscard]] DataFolder& data() { return m_data; }
    [[nodiscard]] const Captions& captions() const { return m_captions; }
    [[nodiscard]] ProgramState& state() { return m_state; }
    [[nodiscard]] Clock& clock() { return m_clock; }
    /// False when there is no VISA library for it; open() tells why.
    [[nodiscard]] bool hasSession() const { return m_session != nullptr; }
    [[nodiscard]] Session& session() { return *m_session; }

private:
    void passed(const Traffic& traffic) override;
    void stepGoesOut(const Step& step, std::size_t number, std::size_t total) override;
    void stepAnswered(const Step&, const std::string&) override {}
    void stepsEnded() override;

    bool linkFailed();
    void reconnected();
    [[nodiscard]] std::string statusText() const;

    const Call& m_call;
    Output& m_output;
    int m_stop;
    PacedClock m_clock;
    DataFolder m_data;
    ProgramState m_state;
    Captions m_captions;
    ChosenVisa m_link;
    std::unique_ptr<Session> m_session;
    bool m_held = false;
    bool m_lost = false;  ///< the link, and no new one was made yet
    bool m_failed = false;
    bool m_refused = false;  ///< a list that the coder cannot take
    bool m_stopped = false;
    bool m_finishing = false;
    bool m_inSteps = false;     ///< which tell their number themselves
    std::size_t m_written = 0;  ///< commands and questions besides
    std::size_t m_expected = 0;
};

}  // namespace kdx::ctl
