#include "scenario/playtest.h"

#include <utility>

namespace kdx::test {

PlayTest::PlayTest() {
    EXPECT_EQ(session.open("TCPIP", "10.0.0.1"), 0);
    session.instrument.onFailure([this](const std::string&, bool) {
        stopped = true;
        return true;
    });
    clock.correctMidnight(true);
    begin = clock.steadyNow();
}

scenario::Scenario PlayTest::read(const std::string& text) {
    scenario::Reading reading = scenario::readScenario(text);
    for (const auto& problem : reading.problems)
        ADD_FAILURE() << problem.line << ":" << problem.column << ": " << problem.sentence;
    return std::move(reading.scenario);
}

scenario::Outcome PlayTest::play(const std::string& text, const scenario::RunOptions& options) {
    begin = clock.steadyNow();
    return scenario::Runner({session, state, clock, *this, *this, this, report}).run(read(text), options);
}

scenario::RunOptions PlayTest::part(const std::string& from, const std::string& until) {
    return {scenario::readStepNumber(from), scenario::readStepNumber(until)};
}

bool PlayTest::goesOn() {
    if (stopAt && clock.steadyNow() - begin >= *stopAt) stopped = true;
    return !stopped;
}

scenario::Attendant::Return PlayTest::pressed() {
    if (returns.empty() || clock.steadyNow() - begin < returns.front())
        return inputEnds ? Return::NoLonger : Return::NotYet;
    returns.pop_front();
    return Return::Pressed;
}

void PlayTest::begins(const std::string& step, const scenario::Action& action) {
    begun.push_back(step + " " + scenario::describe(action));
}

void PlayTest::happened(const scenario::Row& row) {
    std::string line = row.step + " " + row.key + "=" + row.value + " " + row.status;
    if (!row.answer.empty()) line += " " + row.answer;
    heard.push_back(line);
    rows.push_back(row);
}

void PlayTest::waits(std::chrono::nanoseconds length) {
    waited.push_back(std::chrono::duration_cast<std::chrono::milliseconds>(length).count());
}

bool PlayTest::remember() {
    heard.emplace_back("remember");
    return remembers;
}

std::optional<SettingCommands> PlayTest::commands() {
    heard.emplace_back("bring back");
    if (silentRestores-- > 0) return std::nullopt;
    return SettingCommands{{"TA", direct("TA=0")}};
}

long PlayTest::sinceBegin() const {
    return std::chrono::duration_cast<std::chrono::milliseconds>(clock.steadyNow() - begin).count();
}

}  // namespace kdx::test
