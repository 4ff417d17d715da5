#pragma once

#include <optional>
#include <set>
#include <string>
#include <utility>
#include <vector>

#include "link/traffic.h"
#include "scenario/attendance.h"
#include "scenario/schedule.h"
#include "scenario/stepnumber.h"

namespace kdx {
struct ProgramState;
struct Session;
}  // namespace kdx

namespace kdx::scenario {

/// What a run works with; everything is lent.
struct Surroundings {
    Session& session;  ///< open, the scenario's data set loaded
    ProgramState& state;
    Clock& clock;
    Attendant& attendant;
    Watcher& watcher;
    Restorer* restorer = nullptr;
    const Report* report = nullptr;  ///< begun
};

/// Which part of a scenario is run, and how.
struct RunOptions {
    std::optional<StepNumber> from;   ///< begins with it; steps of the scenario
    std::optional<StepNumber> until;  ///< ends after it, the first time
    bool nobodyThere = false;         ///< pauses go on by themselves, nothing waits for Return
};

/// Takes a scenario to the instrument.
class Runner : private TrafficWatcher {
public:
    explicit Runner(const Surroundings& with);
    ~Runner() override;
    Runner(const Runner&) = delete;
    Runner& operator=(const Runner&) = delete;

    /// Runs the scenario once. What is to be restored is restored however the run ends, by an exception too.
    Outcome run(const Scenario& scenario, RunOptions options);

private:
    /// What comes after a step.
    enum class Flow {
        Next,
        Returned,  ///< a person's Return ends the innermost loop that waits for it
        Reached,   ///< the part that was asked for is done
        Ends,      ///< stopped, or failed
    };

    void play(const Scenario& scenario);
    void bringBack();
    /// @returns whether all could be asked and sent.
    bool bringBackOnce();
    template <typename Asks>
    auto silently(Asks asks);
    Flow list(const std::vector<Action>& actions);
    Flow one(const Action& action);
    Flow loop(const Action& action);
    Flow passes(const Action& action, std::size_t first);
    Flow pass(const Action& action);
    Flow send(const std::string& key, const std::string& value);
    Flow message(const std::string& code);
    Flow expect(const Action& action);
    Flow pause(const Action& action);
    Flow waitUntil(Schedule::Time time);
    Flow askUntilMet(const Action::Expectation& expectation, Schedule::Time deadline, Row& row, bool& waited);
    Flow afterCommand() { return goesOn() ? Flow::Next : Flow::Ends; }
    [[nodiscard]] bool goesOn() { return !m_outcome.reportLost && m_with.attendant.goesOn(); }
    [[nodiscard]] Flow unlessReached() const {
        return m_options.until && isReached(m_number, *m_options.until) ? Flow::Reached : Flow::Next;
    }
    void tell(Row row);
    void passed(const Traffic& traffic) override;

    Surroundings m_with;
    RunOptions m_options;
    Outcome m_outcome;
    Schedule m_schedule;
    StepNumber m_number;
    std::string m_place;                            ///< instead of the number, where there is none
    std::pair<std::string, std::string> m_setting;  ///< key and value that go out
    std::set<std::string> m_sent;                   ///< keys that went out
    bool m_wholeSent = false;                       ///< a data set, with all its keys
    std::optional<std::string> m_questions;         ///< while an expectation asks: what it has asked
    int m_listening = 0;                            ///< loops that end with a person's Return
    bool m_otherVariant = false;                    ///< of the announcement before a traffic message
};

}  // namespace kdx::scenario
