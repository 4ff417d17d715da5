#pragma once

#include <QObject>

#include <map>
#include <memory>
#include <optional>
#include <vector>

#include "lab/heldclock.h"
#include "scenario/report.h"
#include "scenario/runner.h"
#include "ui/pagecontext.h"

namespace kdx {

class Ticker;

/// A scenario that runs while the window stays in use: between its steps and in its pauses a timer waits.
class ScenarioRun : public QObject, private scenario::Attendant, private scenario::Watcher {
    Q_OBJECT
public:
    ScenarioRun(Session& session, const PageContext& with, QObject* parent);
    ~ScenarioRun() override;

    /// Runs it from its beginning. @param report file that keeps what happens; empty for none.
    /// @returns why the report cannot be begun; nothing when it runs.
    [[nodiscard]] std::optional<scenario::ReportFault> begin(const scenario::Scenario& scenario,
                                                             const std::filesystem::path& report);
    /// It stands still, or goes on.
    void setHeld(bool held);
    /// Ends it after the running command; what stood before comes back first. The second time that is given up, too,
    /// where the instrument does not answer.
    void stop();
    /// The same, and no announcement of traffic is left on the air, nor brought back.
    void panic();
    /// Ends it at once, what stood before brought back: the session is to be closed.
    void finish();
    /// The person is done with what a step asks for.
    void goOn() { m_pressed = true; }
    /// A command failed. @returns whether nobody need be told: it was the run's, and not its first.
    bool takesFailure();

    [[nodiscard]] bool isRunning() const { return m_runner != nullptr; }
    /// Whether what goes out right now is the run's.
    [[nodiscard]] bool isAtWork() const { return m_inside; }
    /// Whether it is over but for what stood before, which is being set again.
    [[nodiscard]] bool isRestoring() const { return m_finishes; }
    [[nodiscard]] bool isHeld() const { return m_clock.isHeld(); }
    /// Whether a step waits for a person, or would end at a word of one.
    [[nodiscard]] bool asks() const { return m_asks; }
    /// How long the present wait lasts still.
    [[nodiscard]] std::chrono::nanoseconds left() const;

signals:
    void stepBegan(const std::string& step);
    void rowAdded(const kdx::scenario::Row& row);
    /// What the functions above tell may be something else.
    void changed();
    void over(const kdx::scenario::Outcome& outcome);

private:
    class Restorer;

    void AblaufTimer_Timer();
    /// @returns how long the pause lasts; nothing at the end.
    std::optional<std::chrono::nanoseconds> goOnToPause();
    void close();
    void endAnnouncements();
    void sendDataSet(int number);

    bool goesOn() override { return m_finishes || (!m_stopped && !m_failed); }
    void forgetsTyped() override { m_pressed = false; }
    Return pressed() override;
    void finishes() override;
    void begins(const std::string& step, const scenario::Action&) override { emit stepBegan(step); }
    void happened(const scenario::Row& row) override;
    void waits(std::chrono::nanoseconds length) override { m_until = m_clock.steadyNow() + length; }
    void reportLost() override {}
    void ended(const scenario::Outcome&) override {}

    Session& m_session;
    PageContext m_with;
    HeldClock m_clock;
    Ticker* m_timer = nullptr;
    scenario::Scenario m_scenario;
    scenario::Report m_report{{}};
    std::unique_ptr<Restorer> m_restorer;
    std::unique_ptr<scenario::Runner> m_runner;
    std::chrono::steady_clock::time_point m_until;
    std::map<std::string, std::string> m_announcements;  // on the air: the command that ends each, and its key
    std::vector<std::string> m_silenced;                 // keys of those that panic ended
    std::string m_identifier;                            // of the other network at work before
    bool m_inside = false, m_stopped = false, m_failed = false, m_finishes = false, m_hurries = false;
    bool m_pressed = false, m_asked = false, m_asks = false, m_panics = false;
};

}  // namespace kdx
