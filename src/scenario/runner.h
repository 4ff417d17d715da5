#pragma once

#include <optional>
#include <set>
#include <string>
#include <utility>
#include <vector>

#include "link/traffic.h"
#include "scenario/part.h"
#include "scenario/runoptions.h"
#include "scenario/schedule.h"

namespace kdx::scenario {

/// Takes a scenario to the instrument.
class Runner : private TrafficWatcher {
public:
    explicit Runner(const Surroundings& with);
    ~Runner() override;
    Runner(const Runner&) = delete;
    Runner& operator=(const Runner&) = delete;

    /// Runs the scenario once and sleeps through its pauses. What is to be restored is restored however the run ends,
    /// by an exception too.
    Outcome run(const Scenario& scenario, RunOptions options);

    /// The same in pieces, for who has other things to do in the pauses: begins it. @param scenario lent.
    void start(const Scenario& scenario, RunOptions options);
    /// Goes on to the next pause. @returns how long it lasts; nothing when the run has ended.
    [[nodiscard]] std::optional<std::chrono::nanoseconds> goOn();
    /// How the run went that has ended.
    [[nodiscard]] const Outcome& outcome() const { return m_outcome; }

private:
    /// What comes after a step.
    enum class Flow {
        Next,
        Returned,  ///< a person's Return ends the innermost loop that waits for it
        Reached,   ///< the part that was asked for is done
        Ends,      ///< stopped, or failed
    };

    using Course = Part<Flow>;

    Course whole(const Scenario& scenario);
    Course play(const Scenario& scenario);
    Course bringBack();
    /// @returns whether all could be asked and sent.
    bool bringBackOnce();
    template <typename Asks>
    auto silently(Asks asks);
    Course list(const std::vector<Action>& actions);
    Course one(const Action& action);
    Course loop(const Action& action);
    Course passes(const Action& action, std::size_t first);
    Course pass(const Action& action);
    Flow send(const std::string& key, const std::string& value);
    Course sendAll(const Action& action);
    Flow message(const std::string& code);
    Course expect(const Action& action);
    Course pause(const Action& action);
    Course waitUntil(Schedule::Time time);
    Course askUntilMet(const Action::Expectation& expectation, Schedule::Time deadline, Row& row, bool& waited);
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
    Pauses m_pauses;
    std::optional<Course> m_whole;
    bool m_otherVariant = false;  ///< of the announcement before a traffic message
};

}  // namespace kdx::scenario
