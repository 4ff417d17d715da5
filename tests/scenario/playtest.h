#pragma once

#include <gtest/gtest.h>

#include "scenario/reader.h"
#include "scenario/runner.h"
#include "station/session.h"
#include "support/linkfixture.h"

namespace kdx::test {

/// A scenario played to a scripted instrument by a clock that only sleeps move. What goes on is written down as lines.
class PlayTest : public ::testing::Test,
                 protected Bench,
                 protected scenario::Attendant,
                 protected scenario::Watcher,
                 protected scenario::Restorer {
protected:
    PlayTest() {
        EXPECT_EQ(session.open("TCPIP", "10.0.0.1"), 0);
        session.instrument.onFailure([this](const std::string&, bool) {
            stopped = true;
            return true;
        });
        clock.correctMidnight(true);
        begin = clock.steadyNow();
    }

    static scenario::Scenario read(const std::string& text) {
        scenario::Reading reading = scenario::readScenario(text);
        for (const auto& problem : reading.problems)
            ADD_FAILURE() << problem.line << ":" << problem.column << ": " << problem.sentence;
        return std::move(reading.scenario);
    }
    scenario::Outcome play(const std::string& text, const scenario::RunOptions& options = {}) {
        begin = clock.steadyNow();
        return scenario::Runner({session, state, clock, *this, *this, this, report}).run(read(text), options);
    }
    /// From a step to a step; "" for the whole.
    static scenario::RunOptions part(const std::string& from, const std::string& until) {
        return {scenario::readStepNumber(from), scenario::readStepNumber(until)};
    }

    bool goesOn() override {
        if (stopAt && clock.steadyNow() - begin >= *stopAt) stopped = true;
        return !stopped;
    }
    Return pressed() override {
        if (returns.empty() || clock.steadyNow() - begin < returns.front())
            return inputEnds ? Return::NoLonger : Return::NotYet;
        returns.pop_front();
        return Return::Pressed;
    }
    void forgetsTyped() override { ++forgotten; }
    void finishes() override { heard.emplace_back("finishes"); }
    void begins(const std::string& step, const scenario::Action& action) override {
        begun.push_back(step + " " + scenario::describe(action));
    }
    void happened(const scenario::Row& row) override {
        std::string line = row.step + " " + row.key + "=" + row.value + " " + row.status;
        if (!row.answer.empty()) line += " " + row.answer;
        heard.push_back(line);
        rows.push_back(row);
    }
    void waits(std::chrono::nanoseconds length) override {
        waited.push_back(std::chrono::duration_cast<std::chrono::milliseconds>(length).count());
    }
    void reportLost() override { heard.emplace_back("report lost"); }
    void ended(const scenario::Outcome&) override { heard.emplace_back("ended"); }
    bool remember() override {
        heard.emplace_back("remember");
        return remembers;
    }
    std::optional<SettingCommands> commands() override {
        heard.emplace_back("bring back");
        if (silentRestores-- > 0) return std::nullopt;
        return SettingCommands{{"TA", direct("TA=0")}};
    }
    [[nodiscard]] Lines untold() const override { return silentBefore; }
    std::optional<Lines> changed() override { return Lines{}; }

    Session session{visa, state, data, captions, clock, [] {}};
    const scenario::Report* report = nullptr;
    std::chrono::steady_clock::time_point begin;
    std::optional<std::chrono::milliseconds> stopAt;  ///< somebody stops the run
    bool stopped = false;
    bool remembers = true;
    int silentRestores = 0;                         ///< how often it cannot be asked what it has now
    int forgotten = 0;                              ///< how often what was typed was thrown away
    Lines silentBefore;                             ///< keys whose values it does not remember
    std::deque<std::chrono::milliseconds> returns;  ///< when a person presses Return
    bool inputEnds = false;
    Lines begun;
    Lines heard;
    std::vector<scenario::Row> rows;
    std::vector<long> waited;
    std::vector<long> writtenAt;  ///< milliseconds since the begin

private:
    TrafficListener m_listener{session.instrument, [this](const Traffic& traffic) {
                                   if (traffic.kind == Traffic::Kind::Written) writtenAt.push_back(sinceBegin());
                               }};
    [[nodiscard]] long sinceBegin() const {
        return std::chrono::duration_cast<std::chrono::milliseconds>(clock.steadyNow() - begin).count();
    }
};

}  // namespace kdx::test
